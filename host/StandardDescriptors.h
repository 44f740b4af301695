#pragma once

namespace pallax {

/// Opens any closed ones of the descriptors 0, 1 and 2, before other files are opened: a file with
/// such a number would be read as standard input, or receive standard output or error. Input opened
/// here is empty; writing to output or error fails as for a closed descriptor. False on failure.
bool openStandardDescriptors();

} // namespace pallax
