#pragma once

namespace pallax::gtk {

/// The text in the user's language; itself where there is no translation (see po/). What the system
/// shows of a modem is not translated: names of sections and fields, states, status and alerts.
const char* translated(const char* english);

/// Takes the user's language for texts, but not for numbers and dates, from the environment, and
/// the translations from this folder ("/usr/share/locale").
void useTranslations(const char* folder);

} // namespace pallax::gtk
