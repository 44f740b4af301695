#include "fields/IfxSections.h"

namespace pallax {

std::vector<SectionReference> ifxSections() {
    const auto keys = [](std::string name, std::vector<std::string> objectKeys) {
        const std::string path = "/" + name;
        return SectionReference{std::move(name), path, false, {}, std::move(objectKeys)};
    };
    const auto list = [](std::string name, std::vector<std::string> objectKeys,
                         std::vector<std::string> identifyingKeys) {
        const std::string path = "/" + name;
        return SectionReference{std::move(name),           path, true, {}, std::move(objectKeys),
                                std::move(identifyingKeys)};
    };
    return {
        keys("Network", {"Name", "MCC", "MNC"}),
        keys("RR", {}),
        keys("Serving Cell", {"ARFCN", "BSIC", "Rx Level", "C1", "Area", "LAC", "Cell ID"}),
        list("Neighbour Cells", {"ARFCN", "BSIC", "Rx Level"}, {"ARFCN", "BSIC"}),
        keys("Dedicated Channel",
             {"Channel", "Time Slot", "Timing Advance", "Rx Quality", "Tx Power", "Hopping"}),
        list("Barred Cells", {}, {""}),
    };
}

} // namespace pallax
