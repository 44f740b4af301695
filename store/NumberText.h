#pragma once

#include <string>

namespace pallax {

class NumberFormat;

/// The format as printf() has it: "%.2f dBm".
std::string printfText(const NumberFormat& format);

} // namespace pallax
