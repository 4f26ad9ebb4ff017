#if !defined(_WIN32)

#include <dlfcn.h>
#include <link.h>

#include <cstdio>
#include <cstdlib>

#include "frame/module.h"

namespace krnumer::module {
namespace {

// A search that starts at the main program goes on through every library in the global scope, so a symbol counts
// as the program's own only if its address lies in one of the program's own segments. The program is the first
// object that the loader reports.
bool LiesInMainProgram(const void* address) {
    const auto in_first_object = [](dl_phdr_info* object, std::size_t, void* wanted) {
        const auto offset = reinterpret_cast<ElfW(Addr)>(wanted) - object->dlpi_addr;
        for (int i = 0; i < object->dlpi_phnum; ++i) {
            const auto& segment = object->dlpi_phdr[i];
            if (segment.p_type == PT_LOAD && offset - segment.p_vaddr < segment.p_memsz) return 1;
        }
        return -1;
    };
    return dl_iterate_phdr(in_first_object, const_cast<void*>(address)) == 1;
}

}  // namespace

Module Find() {
    const Module program{dlopen(nullptr, RTLD_LAZY), true};
    for (const char* mark : kHostMarks)
        if (Export(program, mark) != nullptr) return program;
    return {dlopen("libkrrt.so", RTLD_LAZY | RTLD_NOLOAD), false};
}

void* Export(Module module, const char* name) {
    void* const address = dlsym(module.handle, name);
    return module.only_its_own && !LiesInMainProgram(address) ? nullptr : address;
}

void Fatal(const char* message) {
    std::fprintf(stderr, "Fatal Error\n%s\n", message);
    std::exit(1);
}

}  // namespace krnumer::module

#endif
