// The module's exported entry: hosts look up "VSTPluginMain" or "main".
#include "host/instance_factory.h"

#if defined(_WIN32)
#define PLUGIN_EXPORT extern "C" __declspec(dllexport)
#else
#define PLUGIN_EXPORT extern "C" __attribute__((visibility("default")))
#endif

PLUGIN_EXPORT AEffect* VSTPluginMain(Vst2HostCallback host) { return plugcore::create_instance(host); }

#if !defined(_WIN32)
// "main" cannot be defined as a C++ function of this type; an assembler name gives
// the same exported symbol (the Windows module exports it through its .def file).
PLUGIN_EXPORT AEffect* vst_legacy_main(Vst2HostCallback host) __asm__("main");
AEffect* vst_legacy_main(Vst2HostCallback host) { return plugcore::create_instance(host); }
#endif
