#pragma once

namespace pallax {

/// Starts the toolkit as every process of the application does: in the user's language, and by the
/// application's name. False, with a sentence on standard error, where there is no display.
bool startToolkit();

} // namespace pallax
