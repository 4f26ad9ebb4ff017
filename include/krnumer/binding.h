/*
 * Binding to a host.
 *
 * krnumer finds the host by itself at the first call that needs it: in the main program if that exports `gKRRTVersion`
 * or `MakeZoneBlock`, else in the module libkrrt.so (krrt.dll on Windows) if it is loaded. Where neither holds, the
 * process ends with a message on standard error (a message box on Windows) and exit code 1.
 */
#ifndef KRNUMER_BINDING_H
#define KRNUMER_BINDING_H

#include <krnumer/types.h>

/**
 * Names the loaded module that holds the host's services.
 *
 * Counts for the services that are not resolved yet; one that has been used stays as it is.
 *
 * @param module  a handle of dlopen (an HMODULE on Windows), or null to return to the look-up by itself
 * @return        `module`, unchanged and unchecked
 */
KRNUMER_API void* SetKRRTModule(void* module);

#endif
