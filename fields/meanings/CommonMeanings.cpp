#include "fields/Meanings.h"

#include <array>

namespace pallax {

namespace {

constexpr std::string_view kSim = "SIM Info";
constexpr std::string_view kContexts = "PDP Context Info";

// clang-format off
constexpr auto kMeanings = std::to_array<Meaning>({
    {kSim, "", "Elementary files of the SIM, as read by the telephony service."},
    {kSim, "EF-ICCID", "Identity of the card."},
    {kSim, "EF-MSISDN", "The subscriber's own number."},
    {kSim, "EF-3GPP MAIL BOX DIALING NUMBER", "Number of the voice mailbox."},
    {kSim, "EF-HPPLMN SEARCH PERIOD", "How often a roaming phone looks for a network of higher priority."},
    {kSim, "EF-LOCI", "Temporary identity, location area and update status of the circuit-switched domain."},
    {kSim, "EF-GPRS/PS-LOCI", "Temporary identity, routing area and update status of the packet-switched domain."},
    {kSim, "EF-ACCESS CONTROL CLASS", "Access control classes of the subscriber."},
    {kSim, "EF-ADMINISTRATIVE DATA", "Mode of operation of the card, and the length of the network code in its IMSI."},
    {kSim, "EF-FPLMN", "Forbidden networks."},
    {kSim, "EF-ACTING HPLMN", "Network that counts as the home network."},
    {kSim, "EF-RAT MODE", "Radio access technologies that the card prefers."},
    {kSim, "EF-PLMN NETWORK NAME", "Names of networks."},
    {kSim, "EF-OPERATOR PLMN LIST", "Networks and areas to which the names in EF-PNN apply."},
    {kSim, "EF-OPLMNAcT", "Networks that the operator prefers, with their access technologies."},

    {kContexts, "", "The packet data contexts, each as the telephony service describes it."},
});

constexpr auto kCodeNames = std::to_array<CodeName>({
    {0xFF0000, "SIM files"},
    {0xFF0001, "Cell monitor"},
    {0xFF0002, "Contexts of packet data"},
});
// clang-format on

} // namespace

Meanings commonMeanings() {
    return {kMeanings, kCodeNames};
}

} // namespace pallax
