#include "querying/EditedLines.h"

#include "host/Complaint.h"
#include "querying/Interrupt.h"
#include "text/Format.h"

#include <cerrno>
#include <clocale>
#include <csignal>
#include <cwchar>
#include <histedit.h>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

constexpr std::size_t kMostShown = 200; ///< words of a completion
constexpr wchar_t kInterruptKey = L'\x03';
// What mbrtowc() returns besides lengths.
constexpr auto kWrongBytes = static_cast<std::size_t>(-1);
constexpr auto kTooFewBytes = static_cast<std::size_t>(-2);

class EditedLines final : public LineReader {
public:
    EditedLines(QueryHistory history, Completer completer)
        : _history(std::move(history)), _completer(std::move(completer)), _edit(open()),
          _events(history_init()) {
        if (!_edit || !_events) {
            return;
        }
        EditLine* const edit = _edit.get();
        el_set(edit, EL_CLIENTDATA, this);
        el_set(edit, EL_PROMPT, &prompt);
        el_set(edit, EL_EDITOR, "emacs");
        el_set(edit, EL_SIGNAL, 1);
        el_set(edit, EL_GETCFN, &key);
        el_set(edit, EL_HIST, &::history, _events.get());
        el_set(edit, EL_ADDFN, "pallax-complete", "Complete a name", &complete);
        el_set(edit, EL_BIND, "\t", "pallax-complete", nullptr);
        // While a line is edited, Ctrl-C and Ctrl-Z are keys like others.
        el_set(edit, EL_SETTY, "-d", "-isig", nullptr);
        el_set(edit, EL_ADDFN, "pallax-clear", "Take the line back", &clear);
        el_set(edit, EL_BIND, "^C", "pallax-clear", nullptr);
        el_set(edit, EL_ADDFN, "pallax-suspend", "Suspend the program", &suspend);
        el_set(edit, EL_BIND, "^Z", "pallax-suspend", nullptr);
        el_set(edit, EL_BIND, "^R", "em-inc-search-prev", nullptr);
        HistEvent event;
        ::history(_events.get(), &event, H_SETSIZE,
                  static_cast<int>(QueryHistory::kMostStatements));
        ::history(_events.get(), &event, H_SETUNIQUE, 1);
        for (const std::string& statement : _history.load()) {
            ::history(_events.get(), &event, H_ENTER, statement.c_str());
        }
    }

    bool isReady() const { return _edit && _events; }

    Outcome read(const std::string& before, std::string& line) override {
        const Interrupt sinceNow(Interrupt::Watched::Yes);
        _before = before;
        _isCleared = false;
        int count = 0;
        const char* const text = el_gets(_edit.get(), &count);
        if (_isCleared) {
            (void)!::write(STDOUT_FILENO, "\n", 1);
            return Outcome::Cleared;
        }
        if (text == nullptr || count <= 0) {
            (void)!::write(STDOUT_FILENO, "\n", 1);
            return Outcome::End;
        }
        line.assign(text, static_cast<std::size_t>(count));
        if (line.ends_with('\n')) {
            line.pop_back();
        }
        return Outcome::Line;
    }

    void remember(const std::string& statement) override {
        const std::string line = QueryHistory::lineOf(statement);
        HistEvent event;
        ::history(_events.get(), &event, H_ENTER, line.c_str());
        if (!_history.add(statement) && !std::exchange(_hasComplained, true)) {
            complain(formatText("The history cannot be kept in %@.", {_history.path()}));
        }
    }

private:
    struct End {
        void operator()(EditLine* edit) const { el_end(edit); }
        void operator()(History* history) const { history_end(history); }
    };

    static std::unique_ptr<EditLine, End> open() {
        (void)std::setlocale(LC_CTYPE, ""); // NOLINT(concurrency-mt-unsafe) letters of the terminal
        return std::unique_ptr<EditLine, End>(el_init("pallax", stdin, stdout, stderr));
    }
    static EditedLines& of(EditLine* edit) {
        void* self = nullptr;
        el_get(edit, EL_CLIENTDATA, &self);
        return *static_cast<EditedLines*>(self);
    }
    static const char* prompt(EditLine* edit) {
        return of(edit)._before.empty() ? kPrompt : kPromptOfMore;
    }
    /// The next key of the terminal: 1, or 0 at its end. A Ctrl-C that came before the terminal
    /// took keys one by one was a signal; here it becomes the key that it was.
    static int key(EditLine* edit, wchar_t* key) {
        std::mbstate_t state{};
        for (;;) {
            if (of(edit)._always.hasCome()) {
                *key = kInterruptKey;
                return 1;
            }
            char byte = 0;
            const ssize_t count = ::read(STDIN_FILENO, &byte, 1);
            if (count < 0 && errno == EINTR) {
                continue;
            }
            if (count <= 0) {
                return static_cast<int>(count);
            }
            const std::size_t length = std::mbrtowc(key, &byte, 1, &state);
            if (length == kWrongBytes) {
                state = {};
            } else if (length != kTooFewBytes) {
                return 1;
            }
        }
    }
    static unsigned char clear(EditLine* edit, int /*key*/) {
        of(edit)._isCleared = true;
        return CC_NEWLINE;
    }
    static unsigned char suspend(EditLine* /*edit*/, int /*key*/) {
        (void)::kill(0, SIGTSTP); // the library restores the terminal meanwhile
        return CC_REDISPLAY;
    }
    static unsigned char complete(EditLine* edit, int /*key*/) {
        EditedLines& self = of(edit);
        const LineInfo* const info = el_line(edit);
        const std::string_view line(info->buffer,
                                    static_cast<std::size_t>(info->cursor - info->buffer));
        const std::string before = self._before.empty() ? "" : self._before + "\n";
        const std::string text = before + std::string(line);
        const SqlCompletion completion = self._completer(text);
        return self.insert(completion, text.substr(completion.begin));
    }
    /// Writes what the words have in common, or else all of them.
    unsigned char insert(const SqlCompletion& completion, const std::string& word) {
        if (completion.words.empty()) {
            return CC_ERROR;
        }
        std::string added = commonStart(completion.words).substr(word.size());
        const bool isWhole = completion.words.size() == 1;
        const char last = completion.words.front().back();
        added += isWhole && last != '.' && last != '(' ? " " : "";
        if (!added.empty()) {
            return el_insertstr(_edit.get(), added.c_str()) == 0 ? CC_REFRESH : CC_ERROR;
        }
        std::string shown = "\n";
        for (std::size_t place = 0; place < completion.words.size() && place < kMostShown;
             ++place) {
            shown.append(completion.words[place]).append("  ");
        }
        shown += completion.words.size() > kMostShown ? "...\n" : "\n";
        (void)!::write(STDOUT_FILENO, shown.data(), shown.size());
        return CC_REDISPLAY;
    }

    QueryHistory _history;
    Completer _completer;
    std::unique_ptr<EditLine, End> _edit;
    std::unique_ptr<History, End> _events;
    std::string _before;
    /// Between two lines, when the terminal still sends signals, Ctrl-C must not end the program.
    const Interrupt _always{Interrupt::Watched::Yes};
    bool _isCleared = false;
    bool _hasComplained = false;
};

} // namespace

std::unique_ptr<LineReader> editedLines(QueryHistory history, Completer completer) {
    auto lines = std::make_unique<EditedLines>(std::move(history), std::move(completer));
    return lines->isReady() ? std::move(lines) : nullptr;
}

} // namespace pallax
