#pragma once

#include "plist/PropertyList.h"

namespace pallax::terminal {

/// A section of an LTE display.
inline Dictionary measurements(const char* rsrp = "-94.75 dBm") {
    return Dictionary{{"Version", "1"},
                      {"E-ARFCN", "1850"},
                      {"Physical Cell ID", "274"},
                      {"Measured RSRP", rsrp},
                      {"Average RSRP", "-95.00 dBm"},
                      {"Measured RSRQ", "-9.50 dB"}};
}

/// An LTE display: sections, lists, and a leaf at the top.
inline PropertyList display(const char* rsrp = "-94.75 dBm") {
    return Dictionary{
        {"Serving Cell Measurements", measurements(rsrp)},
        {"Measured Neighbor Cells",
         Array{Dictionary{{"Physical Cell ID", "275"}}, Dictionary{{"Physical Cell ID", "276"}},
               Dictionary{{"Physical Cell ID", "277"}}}},
        {"Empty List", Array{}},
        {"SIM Info", Dictionary{{"IMSI", "001010123456789"}}},
        {"Operator", "Example"},
    };
}

/// What a snapshot holds, as the save screen lists it.
inline PropertyList snapshotItems() {
    return Array{Dictionary{{"Description", "Snapshot (2023-11-14 22:13:14 +0000)"}},
                 Dictionary{{"Description", "Snapshot (2023-11-14 22:13:16 +0000)"}},
                 Dictionary{{"Description", "DLF binary (48213 bytes)"}}};
}

} // namespace pallax::terminal
