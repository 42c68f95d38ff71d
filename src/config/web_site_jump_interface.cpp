#include "config/web_site_jump_interface.h"

namespace plugcore {

namespace {

struct ActionEntry {
  int code;
  const char* text;
};

constexpr ActionEntry kActions[] = {
    {3, "action=update"},
    {4, "action=preset"},
    {5, "action=documentation"},
};

}  // namespace

std::string WebSiteJumpInterface::get_action(int code) {
  for (const ActionEntry& entry : kActions) {
    if (entry.code == code) return entry.text;
  }
  return std::string();
}

}  // namespace plugcore
