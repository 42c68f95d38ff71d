#pragma once

#include <string>

namespace plugcore {

// Builds the addresses of the maker's web pages that the setup menu opens.
// Codes: 2 product page, 3 updates, 4 presets, 5 documentation.
class WebSiteJumpInterface {
 public:
  virtual ~WebSiteJumpInterface() = default;
  virtual std::string get_url(int code) = 0;
  // The query's action for a code: empty for the product page and unknown codes.
  virtual std::string get_action(int code);
};

}  // namespace plugcore
