#pragma once

#include <cstdint>

namespace guikit {

class MenuRequest;

// Shows a menu tree at the cursor and calls the chosen item's listener.
class MenuInterface {
 public:
  virtual ~MenuInterface() = default;
  virtual int32_t show(const MenuRequest& request) = 0;
  virtual int32_t close() = 0;
};

}  // namespace guikit
