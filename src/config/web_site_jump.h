#pragma once

#include <string>

#include "config/web_site_jump_interface.h"

// The effect's own web jumps: the maker's jump page with this product's id,
// version and skin, plus the action of the entry.
class WebSiteJump : public plugcore::WebSiteJumpInterface {
 public:
  static constexpr const char* kMakerName = "Velmora";
  static constexpr const char* kMakerSite = "https://www.velmora-audio.example";
  static constexpr long kProductId = 22;
  // Version 1.24 written as the hexadecimal number 0x124.
  static constexpr int kVersionNumber = 0x124;
  static constexpr int kSkin = 1;

  std::string get_url(int code) override;
};
