// What the leak checker finds in libraries of others, before main runs; read by its runtime.

extern "C" const char* __lsan_default_suppressions(); // NOLINT(bugprone-reserved-identifier)

extern "C" const char* __lsan_default_suppressions() { // NOLINT(bugprone-reserved-identifier)
    return "leak:__argz_add_sep\n"; // a library's newlocale, where LOCPATH is set
}
