#include "knowledge/Networks.h"

#include "knowledge/CountryCodes.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <set>
#include <string>
#include <vector>

namespace pallax {
namespace {

using Names = std::vector<OperatorName>;
using Countries = std::vector<std::string_view>;

constexpr std::string_view kProviders = R"(<?xml version="1.0"?>
<!DOCTYPE serviceproviders SYSTEM "serviceproviders.2.dtd">
<serviceproviders format="2.0">
<country code="de"><name>Germany (providers)</name>
  <provider><name>Reseller</name><gsm><network-id mcc="262" mnc="01"/></gsm></provider>
  <provider primary="true"><name>Owner</name><name xml:lang="en">The Owner</name>
    <gsm><network-id mcc="262" mnc="01"/><network-id mcc="262" mnc="001"/></gsm></provider>
  <provider primary="true"><name>Second</name><gsm><network-id mcc="262" mnc="01"/></gsm></provider>
  <provider><name>Reseller</name><gsm><network-id mcc="262" mnc="01"/></gsm></provider>
  <provider><gsm><network-id mcc="262" mnc="02"/></gsm></provider>
  <provider><name>Bad codes</name><gsm><network-id mcc="26" mnc="01"/>
    <network-id mcc="262" mnc="1"/><network-id mcc="262" mnc="0x"/><network-id/></gsm></provider>
  <provider><name>CDMA only</name><cdma><sid value="1"/></cdma></provider>
</country>
<country code="gb"><name>United Kingdom</name></country>
</serviceproviders>
)";

constexpr std::string_view kCountries = R"(<!DOCTYPE iso_3166_entries [<!ELEMENT a (b+)>]>
<iso_3166_entries>
<iso_3166_entry alpha_2_code="DE" name="Germany" official_name="Federal Republic of Germany"/>
<iso_3166_entry alpha_2_code="BO" name="Bolivia, Plurinational State of" common_name="Bolivia"/>
<iso_3166_entry alpha_2_code="XX"/>
</iso_3166_entries>
)";

NetworkNames known() {
    NetworkNames names;
    EXPECT_EQ(names.addProviders(kProviders), std::nullopt);
    EXPECT_EQ(names.addCountries(kCountries), std::nullopt);
    return names;
}

TEST(NetworkCode, IsWrittenInSeveralWays) {
    for (const char* text : {"262-01", "262 01", "262/01", "26201"}) {
        EXPECT_EQ(NetworkCode::in(text), (NetworkCode{"262", "01"})) << text;
    }
    EXPECT_EQ(NetworkCode::in("310410"), (NetworkCode{"310", "410"}));
    EXPECT_EQ(NetworkCode::in("262-001"), (NetworkCode{"262", "001"}));
    for (const char* text : {"", "262", "262-", "262-1", "262-0123", "2620123", "26-201", "262--01",
                             "262-0x", "x62-01", "262- 1"}) {
        EXPECT_EQ(NetworkCode::in(text), std::nullopt) << text;
    }
}

TEST(NetworkNames, TheMainProvidersComeFirstAndEachNameOnce) {
    const NetworkNames names = known();
    EXPECT_TRUE(names.hasOperators());
    EXPECT_EQ(names.operatorsOf({"262", "01"}),
              (Names{{"Owner", "de", NameSource::Database, true},
                     {"Second", "de", NameSource::Database, true},
                     {"Reseller", "de", NameSource::Database, false}}));
}

TEST(NetworkNames, TwoAndThreeDigitsAreDifferentNetworks) {
    const NetworkNames names = known();
    EXPECT_EQ(names.operatorsOf({"262", "001"}),
              (Names{{"Owner", "de", NameSource::Database, true}}));
    EXPECT_TRUE(names.operatorsOf({"262", "002"}).empty());
    EXPECT_EQ(names.networksOf("262"), (std::vector<NetworkCode>{{"262", "001"}, {"262", "01"}}));
    EXPECT_TRUE(names.networksOf("26").empty());
}

TEST(NetworkNames, WhatTheNetworkAndTheCardSayComesFirst) {
    const NetworkNames names = known();
    EXPECT_EQ(names.operatorsOf({"262", "001"}, {.network = "Net", .sim = "Card"}),
              (Names{{"Net", "", NameSource::Network, false},
                     {"Card", "", NameSource::Sim, false},
                     {"Owner", "de", NameSource::Database, true}}));
    EXPECT_EQ(names.operatorsOf({"999", "99"}, {.network = "", .sim = "Card"}),
              (Names{{"Card", "", NameSource::Sim, false}}));
    EXPECT_EQ(nameOf(NameSource::Network), "the network");
    EXPECT_EQ(nameOf(NameSource::Sim), "the SIM");
    EXPECT_EQ(nameOf(NameSource::Database), "mobile-broadband-provider-info");
}

TEST(NetworkNames, CountriesHaveTheirCommonNameInEitherOrderOfTheFiles) {
    NetworkNames other;
    EXPECT_EQ(other.addCountries(kCountries), std::nullopt);
    EXPECT_EQ(other.addProviders(kProviders), std::nullopt);
    for (const NetworkNames& names : {known(), other}) {
        EXPECT_TRUE(names.hasCountries());
        EXPECT_EQ(names.countryName("de"), "Germany");
        EXPECT_EQ(names.countryName("bo"), "Bolivia");
        EXPECT_EQ(names.countryName("gb"), "United Kingdom") << "only the providers' file has it";
        EXPECT_EQ(names.countryName("xx"), "");
    }
}

TEST(NetworkNames, WithoutFilesNothingHasAName) {
    const NetworkNames names;
    EXPECT_FALSE(names.hasOperators());
    EXPECT_FALSE(names.hasCountries());
    EXPECT_TRUE(names.operatorsOf({"262", "01"}).empty());
    EXPECT_EQ(names.countryName("de"), "");
}

TEST(NetworkNames, ADamagedFileIsAReasonAndAddsNothing) {
    NetworkNames names;
    EXPECT_EQ(names.addProviders("<serviceproviders><country code=\"de\"></serviceproviders>"),
              "Start-end tags mismatch at byte 39");
    EXPECT_EQ(names.addProviders("<html/>"), "it does not hold \"serviceproviders\"");
    EXPECT_EQ(names.addProviders(""), "No document element found at byte 0");
    EXPECT_EQ(names.addCountries("<serviceproviders/>"), "it does not hold \"iso_3166_entries\"");
    EXPECT_FALSE(names.hasOperators());
    EXPECT_FALSE(names.hasCountries());
}

TEST(NetworkNames, AFileCutAnywhereIsAReason) {
    const std::size_t end = kProviders.rfind("</serviceproviders>");
    for (std::size_t length = 0; length < end; ++length) {
        NetworkNames names;
        EXPECT_NE(names.addProviders(kProviders.substr(0, length)), std::nullopt) << length;
        EXPECT_FALSE(names.hasOperators());
    }
}

TEST(NetworkNames, AnyBytesInAFileAreReadOrAReason) {
    EXPECT_TRUE(doubles::holds([] {
        std::string xml(kProviders);
        for (int change = 0; change < 4; ++change) {
            xml[doubles::any::index(xml.size())] = static_cast<char>(doubles::any::byte());
        }
        NetworkNames names;
        const auto reason = names.addProviders(xml);
        const bool isReason = !reason || (!reason->empty() && reason->back() != '.');
        RC_ASSERT(isReason);
    }));
}

TEST(CountryCodes, FollowFromTheMobileCountryCode) {
    EXPECT_EQ(countryCodesOf("262"), Countries{"de"});
    EXPECT_EQ(countryCodesOf("310"), Countries{"us"});
    EXPECT_EQ(countryCodesOf("316"), Countries{"us"});
    EXPECT_EQ(countryCodesOf("234"), (Countries{"gb", "gg", "im", "je"}));
    EXPECT_EQ(countryCodesOf("202"), Countries{"gr"});
    EXPECT_EQ(countryCodesOf("750"), Countries{"fk"});
    for (const char* code : {"001", "999", "901", "26", "2620", "", "26x", "-62", " 26", "+26"}) {
        EXPECT_TRUE(countryCodesOf(code).empty()) << code;
    }
}

class InstalledNames : public testing::Test {
protected:
    void SetUp() override {
        if (!std::filesystem::exists(kProvidersFile) || !std::filesystem::exists(kCountriesFile)) {
            GTEST_SKIP() << "mobile-broadband-provider-info or iso-codes is not installed.";
        }
        EXPECT_EQ(names.addProviders(doubles::contentOf(kProvidersFile)), std::nullopt);
        EXPECT_EQ(names.addCountries(doubles::contentOf(kCountriesFile)), std::nullopt);
    }

    static constexpr const char* kProvidersFile =
        "/usr/share/mobile-broadband-provider-info/serviceproviders.xml";
    static constexpr const char* kCountriesFile = "/usr/share/xml/iso-codes/iso_3166-1.xml";
    NetworkNames names;
};

TEST_F(InstalledNames, EveryCountryOfTheTableHasAName) {
    int countries = 0;
    for (int mcc = 0; mcc <= 999; ++mcc) {
        const std::string digits = std::to_string(1000 + mcc).substr(1);
        for (const std::string_view country : countryCodesOf(digits)) {
            EXPECT_NE(names.countryName(country), "") << country;
            ++countries;
        }
    }
    EXPECT_EQ(countries, 249);
}

TEST_F(InstalledNames, OfOperatorsAreInTheCountriesOfTheTable) {
    int operators = 0;
    for (int mcc = 0; mcc <= 999; ++mcc) {
        const std::string digits = std::to_string(1000 + mcc).substr(1);
        const Countries expected = countryCodesOf(digits);
        for (const NetworkCode& code : names.networksOf(digits)) {
            for (const OperatorName& each : names.operatorsOf(code)) {
                ++operators;
                const bool isKnown =
                    std::find(expected.begin(), expected.end(), each.country) != expected.end();
                // The file lists a provider of Uganda with codes of Russia.
                EXPECT_TRUE(isKnown || (digits == "250" && each.country == "ug"))
                    << digits << " " << each.name << " " << each.country;
            }
        }
    }
    EXPECT_GT(operators, 800);
}

} // namespace
} // namespace pallax
