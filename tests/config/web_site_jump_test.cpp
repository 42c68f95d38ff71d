// The addresses of the maker's pages for the setup menu's web entries.
#include <gtest/gtest.h>

#include <string>

#include "config/web_site_jump.h"

namespace {

const char kBase[] = "https://www.velmora-audio.example/jump.php?type=product&productid=22&version=292&skin=1";

}  // namespace

TEST(WebSiteJump, AddressForEachEntry) {
  WebSiteJump jump;
  const std::string base = kBase;
  EXPECT_EQ(jump.get_url(2), base);  // the product page ends right after the skin
  EXPECT_EQ(jump.get_url(3), base + "&action=update");
  EXPECT_EQ(jump.get_url(4), base + "&action=preset");
  EXPECT_EQ(jump.get_url(5), base + "&action=documentation");
}

TEST(WebSiteJump, UnknownCodesLeadToTheProductPage) {
  WebSiteJump jump;
  for (int code : {-1, 0, 1, 6, 1000}) {
    EXPECT_EQ(jump.get_action(code), "") << code;
    EXPECT_EQ(jump.get_url(code), kBase) << code;
  }
}
