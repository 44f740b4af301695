#include "tests/cli/EndToEndWeb.h"

#include <csignal>

namespace pallax {

using doubles::getRequest;
using doubles::HttpClient;
using doubles::PallaxProcess;

std::string EndToEndWeb::linkOf(const PallaxProcess& web) {
    EXPECT_TRUE(web.says("/?token=")) << web.err();
    const std::string link = web.out();
    const auto path = link.find("/?token=");
    if (path == std::string::npos) {
        ADD_FAILURE() << link << web.err();
        return "";
    }
    const auto number = link.rfind(':', path) + 1;
    port = static_cast<std::uint16_t>(std::stoi(link.substr(number)));
    host = "127.0.0.1:" + std::to_string(port);
    return link.substr(path, link.find('\n') - path);
}

void EndToEndWeb::enter(const PallaxProcess& web) {
    const std::string path = linkOf(web);
    EXPECT_TRUE(web.out().starts_with("http://127.0.0.1:")) << web.out();
    const std::string entered = answer(getRequest(path, host));
    ASSERT_TRUE(entered.starts_with("HTTP/1.1 303 ")) << entered;
    const auto begin = entered.find("Set-Cookie: ") + 12;
    cookie = "Cookie: " + entered.substr(begin, entered.find(';', begin) - begin) + "\r\n";
}

std::string EndToEndWeb::answer(const std::string& request) const {
    HttpClient client(port);
    client.send(request);
    return client.receive();
}

std::string EndToEndWeb::get(const std::string& path) const {
    return answer(getRequest(path, host, cookie));
}

std::string EndToEndWeb::statusOf(const std::string& request) const {
    const std::string response = answer(request);
    constexpr std::size_t kBefore = 9; // "HTTP/1.1 "
    return response.size() > kBefore ? response.substr(kBefore, 3) : "";
}

void EndToEndWeb::endsQuietly(PallaxProcess& web, const std::string& said) {
    web.signal(SIGINT);
    EXPECT_EQ(web.wait(), 0) << web.err();
    EXPECT_EQ(web.err(), said);
    EXPECT_TRUE(doubles::noChildLeft());
}

} // namespace pallax
