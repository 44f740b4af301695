#pragma once

#include <cstddef>
#include <deque>
#include <memory>
#include <span>
#include <string>
#include <sys/types.h>

struct MHD_Connection;

namespace pallax {

/// The server-sent events for one client, of which a limited amount waits behind the text that the
/// client is taking; that one, such as the first, has any size. The texts are shared by all
/// streams. While nothing waits, the connection is suspended.
class EventStream {
public:
    /// A comment, which clients ignore.
    static constexpr const char* kHeartbeat = ":\n\n";

    /// The connection must outlive the stream.
    EventStream(MHD_Connection& connection, std::size_t mostWaiting)
        : _connection(connection), _mostWaiting(mostWaiting) {}

    /// False if too much waits already: the client is too slow.
    bool add(const std::shared_ptr<const std::string>& text);
    /// Nothing more comes.
    void end();
    /// For the server: puts what waits into `to` and returns its size, 0 while nothing waits, or
    /// the library's mark of the end.
    ssize_t read(std::span<char> to);

private:
    void resume();

    MHD_Connection& _connection;
    std::size_t _mostWaiting;
    std::deque<std::shared_ptr<const std::string>> _waiting;
    std::size_t _taken = 0; ///< of the first text
    std::size_t _bytes = 0; ///< that wait behind the first text
    bool _isSuspended = false;
    bool _hasEnded = false;
};

} // namespace pallax
