#pragma once

#include <cstddef>
#include <cstdint>

#include "config/system_services.h"

namespace sys {

// One entry of the resource table that the build generates for modules without
// a native resource store.
struct ResourceEntry {
  const char* type;
  const char* name;
  const uint8_t* data;
  size_t size;
};

Resource find_in_table(const ResourceEntry* table, int count, const char* type, const char* name);
void report_missing_resource(const char* type, const char* name);

}  // namespace sys

// Defined by the generated resource source that is linked into the module.
extern "C" const sys::ResourceEntry brakmorph_resource_table[];
extern "C" const int brakmorph_resource_count;
