#include "tests/cli/ParsedOptions.h"

namespace pallax {
namespace {

std::string refused(std::vector<std::string> arguments) {
    arguments.insert(arguments.begin(), "web");
    const ParseEnd end = ended(arguments);
    EXPECT_EQ(end.status, kExitWrongUsage);
    return end.text;
}

TEST(WebArguments, WithoutAnyAreTheLiveModemOnThisMachineAlone) {
    const auto options = parsed<WebOptions>({"web"});
    EXPECT_EQ(std::get<ServiceModem>(options.source).name, "");
    EXPECT_EQ(options.address, "127.0.0.1");
    EXPECT_EQ(options.port, 0);
    EXPECT_EQ(options.certificate, "");
    EXPECT_EQ(options.profile, std::nullopt);
    EXPECT_FALSE(options.metrics || options.open || options.withIdentities);
}

TEST(WebArguments, CanNameAStoreInsteadOfASource) {
    const auto options = parsed<WebOptions>({"web", "--store", "s.db", "--device", "car1", "--from",
                                             "start", "--to", "end", "--technology", "lte"});
    EXPECT_EQ(options.store, "s.db");
    EXPECT_EQ(options.device, "car1");
    EXPECT_EQ(options.technology->commandName, "lte");
    EXPECT_TRUE(options.from && options.to && options.to->isEnd());
    for (const char* option : {"--device", "--from", "--to"}) {
        EXPECT_EQ(refused({option, "start"}),
                  std::string("pallax: ") + option + " requires --store (see pallax web --help)\n");
    }
    EXPECT_EQ(refused({"--store", "s.db", "--metrics"}),
              "pallax: --store excludes --metrics (see pallax web --help)\n");
    EXPECT_EQ(refused({"--store", "s.db", "--with-identities"}),
              "pallax: --store excludes --with-identities (see pallax web --help)\n");
    EXPECT_EQ(refused({"--store", "s.db", "demo"}),
              "pallax: demo: it is shown alone, without a store (see pallax web --help)\n");
    EXPECT_EQ(refused({"--store", "s.db", "a.pcap"}),
              "pallax: RECORDING excludes --store (see pallax web --help)\n");
}

TEST(WebArguments, SaySourceAndHowToListen) {
    const auto options = parsed<WebOptions>(
        {"web", "--connect", "car1", "--port", "8080", "--listen", "::", "--certificate", "c.pem",
         "--key", "k.pem", "--metrics", "--open", "--with-identities", "--profile", "field"});
    EXPECT_EQ(std::get<ServiceModem>(options.source).name, "car1");
    EXPECT_EQ(options.port, 8080);
    EXPECT_EQ(options.address, "::");
    EXPECT_EQ(options.certificate, "c.pem");
    EXPECT_EQ(options.key, "k.pem");
    EXPECT_EQ(options.profile, "field");
    EXPECT_TRUE(options.metrics && options.open && options.withIdentities);
    const auto played = parsed<WebOptions>({"web", "a.pcap", "--speed", "max"});
    EXPECT_EQ(std::get<FileRecording>(played.source).path, "a.pcap");
    EXPECT_EQ(played.play.speed, PlayOptions::kAsFastAsTaken);
}

TEST(WebArguments, DemoIsASimulatedModemAndNoRecording) {
    const auto technologyOf = [](const std::vector<std::string>& arguments) {
        const auto options = parsed<WebOptions>(arguments);
        return std::string(std::get<SimulationOptions>(options.source).technology->commandName);
    };
    EXPECT_EQ(technologyOf({"web", "demo"}), "lte");
    EXPECT_EQ(technologyOf({"web", "demo", "gsm", "--speed", "4"}), "gsm");
    EXPECT_EQ(technologyOf({"web", "--speed", "4", "demo", "utran"}), "utran");
    EXPECT_EQ(std::get<FileRecording>(parsed<WebOptions>({"web", "./demo"}).source).path, "./demo");
}

TEST(WebArguments, ThatDoNotGoTogetherAreRefused) {
    EXPECT_EQ(refused({"demo", "lte", "--connect", "car1"}),
              "pallax: demo: it is shown alone, without another source (see pallax web --help)\n");
    EXPECT_EQ(refused({"a.pcap", "demo"}),
              "pallax: demo: it is shown alone, without another source (see pallax web --help)\n");
    EXPECT_EQ(refused({"a.pcap", "--connect", "car1"}),
              "pallax: RECORDING excludes --connect (see pallax web --help)\n");
    EXPECT_EQ(refused({"--speed", "4"}), "pallax: --speed: only a recording or a demo has a speed "
                                         "(see pallax web --help)\n");
    EXPECT_EQ(refused({"--certificate", "c.pem"}),
              "pallax: --certificate requires --key (see pallax web --help)\n");
    EXPECT_EQ(refused({"--key", "k.pem"}),
              "pallax: --key requires --certificate (see pallax web --help)\n");
}

TEST(WebArguments, ThatAreNoneAreNamed) {
    for (const char* port : {"0", "65536", "x", "-1"}) {
        EXPECT_EQ(refused({"--port", port}), "pallax: --port: \"" + std::string(port) +
                                                 "\" is no whole number from 1 to 65535 (see "
                                                 "pallax web --help)\n");
    }
    for (const char* address : {"here", "localhost", "127.1", "1.2.3.4:80", "[::1]", ""}) {
        EXPECT_EQ(refused({"--listen", address}), "pallax: --listen: \"" + std::string(address) +
                                                      "\" is no address of the form 127.0.0.1 or "
                                                      "::1 (see pallax web --help)\n");
    }
    EXPECT_EQ(refused({"demo", "5g"}), "pallax: TECHNOLOGY: \"5g\" is not one of "
                                       "ifx|gsm|cdma|lte|utran (see pallax web --help)\n");
}

} // namespace
} // namespace pallax
