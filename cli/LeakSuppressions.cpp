/// Leaks of libraries that the leak sanitizer is not to report. Only in sanitized builds.
extern "C" const char* __lsan_default_suppressions() { // NOLINT: the sanitizer's name
    // libedit keeps copies of the names of added functions when a line editor ends.
    return "leak:wcsdup\n";
}
