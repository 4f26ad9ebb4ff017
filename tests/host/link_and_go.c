#define _GNU_SOURCE
#include <dlfcn.h>
#include <krrt/krrt.h>
#include <stdio.h>

/* krnumer looks for the services among the modules that are loaded already, by the name of the file. */
int main(void) {
    static const char* const services[] = {"ResizeNumberBlock", "HookCleanup", "MakeBlock", "SizeBlock", "DropBlock"};
    void* host = dlopen("libkrrt.so", RTLD_LAZY | RTLD_NOLOAD);
    if (host == NULL) {
        fputs("libkrrt.so is not loaded\n", stderr);
        return 1;
    }
    for (size_t i = 0; i < sizeof services / sizeof services[0]; ++i) {
        if (dlsym(host, services[i]) == NULL) {
            fprintf(stderr, "libkrrt.so has no %s\n", services[i]);
            return 1;
        }
    }
    return 0;
}
