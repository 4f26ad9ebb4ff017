// Options of the sanitizers, compiled into every test program: the run time looks them up by these names. Sizes near
// the limit of int32 are asked for on purpose, and have to be refused by a null pointer, not by the end of the process.

extern "C" {

__attribute__((visibility("default"))) const char* __asan_default_options() {
    return "allocator_may_return_null=1:max_allocation_size_mb=4096:print_suppressions=0";
}

__attribute__((visibility("default"))) const char* __tsan_default_options() {
    return "allocator_may_return_null=1";
}

__attribute__((visibility("default"))) const char* __ubsan_default_options() {
    return "print_stacktrace=1";
}

// What the loader keeps for itself. The sanitizer knows it by its caller, unless a test's own malloc stands between.
__attribute__((visibility("default"))) const char* __lsan_default_suppressions() {
    return "leak:_dl_map_object_deps\n";
}

}  // extern "C"
