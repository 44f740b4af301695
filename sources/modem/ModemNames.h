#pragma once

/// The names of ModemManager on the system bus.
namespace pallax::modem_names {

inline constexpr const char* kService = "org.freedesktop.ModemManager1";
inline constexpr const char* kRoot = "/org/freedesktop/ModemManager1";
inline constexpr const char* kModemFolder = "/org/freedesktop/ModemManager1/Modem/";

inline constexpr const char* kModem = "org.freedesktop.ModemManager1.Modem";
inline constexpr const char* kModem3gpp = "org.freedesktop.ModemManager1.Modem.Modem3gpp";
inline constexpr const char* kModemCdma = "org.freedesktop.ModemManager1.Modem.ModemCdma";
inline constexpr const char* kSignal = "org.freedesktop.ModemManager1.Modem.Signal";
inline constexpr const char* kLocation = "org.freedesktop.ModemManager1.Modem.Location";
inline constexpr const char* kSim = "org.freedesktop.ModemManager1.Sim";
inline constexpr const char* kBearer = "org.freedesktop.ModemManager1.Bearer";

/// The path of an object that is not there.
inline constexpr const char* kNoObject = "/";

/// Modem.State.
enum State {
    kFailed = -1,
    kUnknown = 0,
    kLocked = 2,
    kDisabled = 3,
    kEnabled = 6, ///< the first state of a modem that is in use
};

} // namespace pallax::modem_names
