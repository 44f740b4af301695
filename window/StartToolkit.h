#pragma once

#include <string>

namespace pallax {

/// Whether the devices in a folder let OpenGL use a graphics processor. Without one, this processor
/// would do its work, which takes longer than the toolkit's own drawing, and 70 MB more.
bool hasGraphicsProcessor(const std::string& folder);

/// Starts the toolkit as every process of the application does: in the user's language, and by the
/// application's name. False, with a sentence on standard error, where there is no display.
bool startToolkit();

} // namespace pallax
