#include "ui/gtk/Translation.h"

#include <clocale>
#include <libintl.h>

namespace pallax::gtk {

namespace {

constexpr const char* kDomain = "pallax-window";

} // namespace

const char* translated(const char* english) {
    return ::dgettext(kDomain, english);
}

void useTranslations(const char* folder) {
    (void)std::setlocale(LC_CTYPE, "");
    (void)std::setlocale(LC_MESSAGES, "");
    (void)::bindtextdomain(kDomain, folder);
    (void)::bind_textdomain_codeset(kDomain, "UTF-8");
}

} // namespace pallax::gtk
