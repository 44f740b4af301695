#pragma once

#include "tests/doubles/WholeTechnology.h"

namespace pallax::doubles {

inline const WholeTechnology kWholeGsm = {
    .subscribers =
        {
            {0x4005, {"GSM Set", "UMTS Set"}},
            {0x4031, {"UMTS RR Info"}},
            {0x4116, {"BLER"}},
            {0x4125, {"UMTS RR Info"}},
            {0x4127, {"UMTS RR Info"}},
            {0x4157, {"UMTS RR Info"}},
            {0x417A, {"Active Set", "Detected Set", "Monitored Set", "Virtual Active Set"}},
            {0x4221, {"HSDPA Info"}},
            {0x5072, {"GSM RR Info"}},
            {0x5076, {"GSM Serving Cell"}},
            {0x512C, {"GSM RR Info"}},
            {0x5134, {"GSM Serving Cell"}},
            {0x5137, {"GPRS Information", "GSM Serving Cell", "Neighboring Cells", "GSM RR Info"}},
            {0x51F4, {"GPRS Information"}},
            {0x51F5, {"GPRS Information"}},
            {0x51F6, {"GPRS Information", "GSM RR Info"}},
            {0x51F8, {"Mobile Allocation"}},
            {0x51FB, {"GPRS Information"}},
            {0x51FD, {"GPRS Information"}},
            {0x51FF, {"Neighboring Cells"}},
            {0x7130, {"Process PS"}},
            {0x7131, {"Process CO", "Process CS"}},
            {0x7132, {"Process PS", "Process CO", "Serving PLMN", "Process CS"}},
            {0x7135, {"GPRS Information", "Serving PLMN"}},
            {0x7150, {"Equivalent PLMN List"}},
            {0xFF0000, {"SIM Info"}},
            {0xFF0001,
             {"GSM Serving Cell", "Neighboring Cells", "Serving PLMN", "UMTS Set", "UMTS RR Info"}},
            {0xFF0002, {"PDP Context Info"}},
        },
    .registration =
        {
            {"Active Set", 1},
            {"Coding Scheme", 0},
            {"GPRS Information", 7},
            {"GSM Serving Cell", 4},
            {"Mobile Allocation", 1},
            {"Neighboring Cells", 3},
            {"PDP Context Info", 1},
            {"Process PS", 2},
            {"UMTS RR Measurement", 0},
            {"Cell Change Counters", 0},
            {"Detected Set", 1},
            {"GSM Set", 1},
            {"Non-Ranked GSM Set", 0},
            {"Process CO", 2},
            {"Serving PLMN", 3},
            {"UMTS Set", 2},
            {"Equivalent PLMN List", 1},
            {"GSM RR Info", 4},
            {"Monitored Set", 1},
            {"Non-Ranked UMTS Set", 0},
            {"Process CS", 2},
            {"UMTS RR Info", 5},
            {"BLER", 1},
            {"Virtual Active Set", 1},
            {"SIM Info", 1},
            {"HSDPA Info", 1},
        },
    .alwaysEmpty = {"Coding Scheme", "UMTS RR Measurement", "Cell Change Counters",
                    "Non-Ranked GSM Set", "Non-Ranked UMTS Set", "Detected Set", "Monitored Set",
                    "Virtual Active Set"},
};

} // namespace pallax::doubles
