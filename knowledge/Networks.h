#pragma once

#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The code of a network. Digits count: "01" and "001" are different networks.
struct NetworkCode {
    std::string mcc; ///< three digits
    std::string mnc; ///< two or three digits

    /// "262-01", "262 01", "262/01" or "26201".
    static std::optional<NetworkCode> in(std::string_view text);

    friend auto operator<=>(const NetworkCode&, const NetworkCode&) = default;
};

/// Where a name of a network comes from. The earlier ones know better.
enum class NameSource {
    Network,  ///< sent by the network itself
    Sim,      ///< stored in the card
    Database, ///< the list of providers
};

/// "the network", "the SIM", "mobile-broadband-provider-info".
std::string_view nameOf(NameSource source);

struct OperatorName {
    std::string name;
    std::string country; ///< ISO 3166, lower case; empty if the source does not tell
    NameSource source = NameSource::Database;
    bool isMain = false; ///< the owner of the network, as opposed to others that sell its service

    friend bool operator==(const OperatorName&, const OperatorName&) = default;
};

/// Names that the modem reported; empty if there is none.
struct ReportedNames {
    std::string_view network;
    std::string_view sim;
};

/// Names of networks and countries, from the content of files. Without them nothing has a name.
class NetworkNames {
public:
    /// Adds the providers in `xml`, the content of mobile-broadband-provider-info's
    /// serviceproviders.xml. Returns the reason, without a full stop, if it is not that file; then
    /// nothing is added.
    std::optional<std::string> addProviders(std::string_view xml);
    /// Adds the countries in `xml`, the content of iso-codes' iso_3166-1.xml; they have better
    /// names than those of the providers' file. Returns like `addProviders`.
    std::optional<std::string> addCountries(std::string_view xml);

    bool hasOperators() const { return !_operators.empty(); }
    bool hasCountries() const { return !_countries.empty(); }

    /// The names of a network: what the modem reported, then the main providers, then the others,
    /// in the order of their file.
    std::vector<OperatorName> operatorsOf(const NetworkCode& code,
                                          const ReportedNames& reported = {}) const;
    /// Every named network of a country code, in the order of the codes.
    std::vector<NetworkCode> networksOf(std::string_view mcc) const;
    /// The name of a country of ISO 3166; empty if it has none here.
    std::string countryName(std::string_view country) const;

private:
    std::map<NetworkCode, std::vector<OperatorName>> _operators;
    std::map<std::string, std::string, std::less<>> _countries;
};

} // namespace pallax
