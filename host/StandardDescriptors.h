#pragma once

namespace pallax {

/// Opens those of the descriptors 0, 1 and 2 that are closed, before anything else is opened: a
/// file that got such a number would be read as standard input, or take what is written to standard
/// output or error. Input opened here is empty; writing to output or error fails as to a closed
/// descriptor. False when that cannot be done.
bool openStandardDescriptors();

} // namespace pallax
