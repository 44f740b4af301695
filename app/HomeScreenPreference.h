#pragma once

namespace pallax {

class Preferences;

/// Stores whether the home screen shows the GSM signal strength, and notifies it. Must be called
/// with false at every exit.
void setGSMRSSI(Preferences& preferences, bool shown);

} // namespace pallax
