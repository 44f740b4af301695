#include "app/HomeScreenPreference.h"

#include "platform/Preferences.h"

#include <string_view>

namespace pallax {

namespace {

constexpr std::string_view kHomeScreenDomain = "com.norvane.plinthe";
constexpr std::string_view kShowGSMRSSI = "PLShowGSMRSSI";

} // namespace

void setGSMRSSI(Preferences& preferences, bool shown) {
    preferences.setValue(kShowGSMRSSI, PropertyList::boolean(shown), kHomeScreenDomain);
    (void)preferences.synchronize(kHomeScreenDomain); // a failure at exit does not matter
    preferences.postChangedNotice(kHomeScreenDomain, kShowGSMRSSI);
}

} // namespace pallax
