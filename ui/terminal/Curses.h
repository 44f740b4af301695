#pragma once

// The curses library with wide characters, and without its macros, whose names are everybody's.
// To be included by this folder's Curses*.cpp only.
#define NCURSES_NOMACROS 1
#define NCURSES_WIDECHAR 1
#include <curses.h>
