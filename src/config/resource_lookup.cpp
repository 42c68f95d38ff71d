#include <string>

#include "config/resource_table.h"
#include "config/system_services.h"

namespace sys {

namespace {

bool same_text_ignoring_case(const char* a, const char* b) {
  for (; *a != 0 && *b != 0; ++a, ++b) {
    char ca = *a >= 'a' && *a <= 'z' ? static_cast<char>(*a - 'a' + 'A') : *a;
    char cb = *b >= 'a' && *b <= 'z' ? static_cast<char>(*b - 'a' + 'A') : *b;
    if (ca != cb) {
      return false;
    }
  }
  return *a == *b;
}

}  // namespace

Resource find_in_table(const ResourceEntry* table, int count, const char* type, const char* name) {
  for (int i = 0; i < count; ++i) {
    if (same_text_ignoring_case(table[i].type, type) && same_text_ignoring_case(table[i].name, name)) {
      Resource r;
      r.data = table[i].data;
      r.size = table[i].size;
      return r;
    }
  }
  return Resource();
}

void report_missing_resource(const char* type, const char* name) {
  std::string text = "sys::get_resource: Error: couldn't load ressource. Name : ";
  text += name;
  text += ", Type : ";
  text += type;
  text += "\n";
  debug_output(text.c_str());
}

}  // namespace sys
