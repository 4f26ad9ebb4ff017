// What the binding to a host needs of the operating system.
#pragma once

namespace krnumer::module {

struct Module {
    void* handle;       // null: no module
    bool only_its_own;  // an export counts only if it lies in the module itself, not in one that it depends on
};

// The module that holds the host's services when none was named: the main program if it marks itself as a host,
// else the host's run-time module if it is loaded already, else none. Never loads anything.
Module Find();

// The address that the module exports under the name, or null.
void* Export(Module module, const char* name);

// Shows the message and ends the process with code 1.
[[noreturn]] void Fatal(const char* message);

// Marks by which a main program tells that it is a host. They are looked up, never used.
inline constexpr const char* kHostMarks[] = {"gKRRTVersion", "MakeZoneBlock"};

}  // namespace krnumer::module
