#include "host/FolderWatch.h"

#include <array>
#include <cerrno>
#include <cstddef>
#include <cstring>
#include <filesystem>
#include <sys/inotify.h>
#include <system_error>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

constexpr std::uint32_t kMask = IN_CLOSE_WRITE | IN_MOVED_TO | IN_CREATE | IN_ONLYDIR;

int openEvents() {
    const int events = ::inotify_init1(IN_NONBLOCK | IN_CLOEXEC);
    if (events < 0) {
        throw std::system_error(errno, std::generic_category(), "inotify");
    }
    return events;
}

} // namespace

FolderWatch::FolderWatch(AsioMainQueue& queue, const std::string& folder, Seen seen)
    : _folder(folder), _seen(std::move(seen)), _events(openEvents()),
      _readable(queue, _events.number()) {
    add(folder);
    if (_folders.empty()) {
        throw std::system_error(errno, std::generic_category(), folder);
    }
    std::error_code ignored;
    for (const auto& entry : std::filesystem::directory_iterator(folder, ignored)) {
        if (entry.is_directory(ignored)) {
            add(entry.path().string());
        }
    }
    wait();
}

void FolderWatch::add(const std::string& folder) {
    const int watch = ::inotify_add_watch(_events.number(), folder.c_str(), kMask);
    if (watch >= 0) {
        _folders[watch] = folder;
    }
}

void FolderWatch::wait() {
    _readable.onceReadable([this] {
        wait();
        look();
    });
}

void FolderWatch::look() {
    constexpr std::size_t kRoom = 16384;
    alignas(inotify_event) std::array<char, kRoom> buffer{};
    const ssize_t size = ::read(_events.number(), buffer.data(), buffer.size());
    for (ssize_t at = 0; at + static_cast<ssize_t>(sizeof(inotify_event)) <= size;) {
        inotify_event event{};
        std::memcpy(&event, buffer.data() + at, sizeof event);
        at += static_cast<ssize_t>(sizeof event);
        // The name is followed by zeros.
        const std::string name = event.len > 0 ? std::string(buffer.data() + at) : std::string();
        at += event.len;
        take(event.wd, event.mask, name);
    }
}

void FolderWatch::take(int watch, unsigned mask, const std::string& name) {
    if ((mask & IN_Q_OVERFLOW) != 0) {
        return _seen.lost();
    }
    const auto folder = _folders.find(watch);
    if (folder == _folders.end()) {
        return;
    }
    if ((mask & IN_IGNORED) != 0) { // the folder is gone
        _folders.erase(folder);
        return;
    }
    const std::string path = folder->second + "/" + name;
    if ((mask & IN_ISDIR) != 0) {
        if (folder->second == _folder) {
            add(path);
            _seen.lost(); // it may have files already
        }
    } else if ((mask & (IN_CLOSE_WRITE | IN_MOVED_TO)) != 0) {
        _seen.file(path);
    }
}

} // namespace pallax
