#include "config/web_site_jump.h"

#include <cstdio>

std::string WebSiteJump::get_url(int code) {
  std::string url = std::string(kMakerSite) + "/jump.php?type=product&";
  char numbers[64];
  std::snprintf(numbers, sizeof(numbers), "productid=%ld&version=%d", kProductId, kVersionNumber);
  url += numbers;
  url += "&skin=" + std::to_string(kSkin);
  const std::string action = get_action(code);
  if (!action.empty()) url += "&" + action;
  return url;
}
