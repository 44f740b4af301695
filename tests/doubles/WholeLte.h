#pragma once

#include "tests/doubles/WholeTechnology.h"

namespace pallax::doubles {

inline const WholeTechnology kWholeLte = {
    .subscribers =
        {
            {0xB0C1, {"Serving Cell Info"}},
            {0xB0C2, {"Serving Cell Info"}},
            {0xB179,
             {"Connected mode LTE Intra-frequency Measurement", "Measured Neighbor Cells",
              "Detected Cells"}},
            {0xB17F, {"Serving Cell Measurements"}},
            {0xB180, {"Neighbor Measurements", "Neighbor Cells List"}},
            {0xB186, {"Reselection Candidates", "Reselection Candidates List"}},
            {0xFF0000, {"SIM Info"}},
            {0xFF0001, {"Serving Cell Info"}},
            {0xFF0002, {"PDP Context Info"}},
        },
    .registration =
        {
            {"Serving Cell Info", 3},
            {"Connected mode LTE Intra-frequency Measurement", 1},
            {"Measured Neighbor Cells", 1},
            {"Detected Cells", 1},
            {"Serving Cell Measurements", 1},
            {"Neighbor Measurements", 1},
            {"Neighbor Cells List", 1},
            {"Reselection Candidates", 1},
            {"Reselection Candidates List", 1},
            {"SIM Info", 1},
            {"PDP Context Info", 1},
        },
    .alwaysEmpty = {},
};

} // namespace pallax::doubles
