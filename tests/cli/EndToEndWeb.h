#pragma once

#include "tests/cli/EndToEnd.h"
#include "tests/doubles/HttpClient.h"

#include <cstdint>
#include <string>

namespace pallax {

/// A browser's side of the real `pallax web`.
class EndToEndWeb : public EndToEnd {
protected:
    /// Waits for the link, and enters.
    void enter(const doubles::PallaxProcess& web);
    /// Waits for the link that the program prints, and takes its port; "/?token=…".
    std::string linkOf(const doubles::PallaxProcess& web);
    /// The response to a request of its own connection.
    std::string answer(const std::string& request) const;
    /// The response to a page that has entered.
    std::string get(const std::string& path) const;
    /// Three digits.
    std::string statusOf(const std::string& request) const;
    /// Interrupts it, as Ctrl-C does, and expects a quiet end.
    static void endsQuietly(doubles::PallaxProcess& web, const std::string& said = "");

    std::uint16_t port = 0;
    std::string host;   ///< "127.0.0.1:PORT"
    std::string cookie; ///< a header line, once entered
};

} // namespace pallax
