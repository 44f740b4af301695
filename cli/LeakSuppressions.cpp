/// Leaks of libraries that the leak sanitizer is not to report. Only in sanitized builds.
extern "C" const char* __lsan_default_suppressions(); // NOLINT(bugprone-reserved-identifier)

extern "C" const char* __lsan_default_suppressions() { // NOLINT(bugprone-reserved-identifier)
    // libedit keeps copies of the names of added functions when a line editor ends.
    return "leak:wcsdup\n";
}
