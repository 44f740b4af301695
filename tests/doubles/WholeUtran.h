#pragma once

#include "tests/doubles/WholeTechnology.h"

namespace pallax::doubles {

inline const WholeTechnology kWholeUtran = {
    .subscribers =
        {
            {0xD00A, {"Neighbor Cell List"}},
            {0xD00C, {"TRCH BLER", "CCTRCH SIR"}},
            {0xD00E, {"GSM Neighbor Cell List"}},
            {0xD0E0, {"RRC Info"}},
            {0xD0E2, {"Serving Cell Info"}},
            {0xFF0000, {"SIM Info"}},
            {0xFF0001, {"Serving Cell Info"}},
            {0xFF0002, {"PDP Context Info"}},
        },
    .registration =
        {
            {"RRC Info", 1},
            {"Serving Cell Info", 2},
            {"Neighbor Cell List", 1},
            {"GSM Neighbor Cell List", 1},
            {"TRCH BLER", 1},
            {"CCTRCH SIR", 1},
            {"PDP Context Info", 1},
            {"SIM Info", 1},
        },
    .alwaysEmpty = {"GSM Neighbor Cell List"},
};

} // namespace pallax::doubles
