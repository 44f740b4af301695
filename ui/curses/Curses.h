#pragma once

// The curses library with wide characters and without its macros, whose names would clash. Only
// this folder's Curses*.cpp include it.
#define NCURSES_NOMACROS 1
#define NCURSES_WIDECHAR 1
#include <curses.h>
