#pragma once

#include <map>
#include <memory>
#include <string>

#include "guikit/font_interface.h"
#include "guikit/pic_data_interface.h"
#include "guikit/picture.h"

// The editor's pictures and fonts by lower-case resource name, read once from the
// module's "APIC" resources and shared by every builder. The table order of the
// skin's resource list is kept, so neighbouring pictures can be found by index.
class SkinPictures {
 public:
  // Reads every picture and font of the skin's resource list; false when one is
  // missing or unreadable (what was read stays).
  bool load_all();
  bool is_loaded() const { return loaded_; }

  // null when the name was not loaded.
  guikit::PicDataInterface* get(const std::string& name) const;
  const guikit::FontInterface* get_font(const std::string& name) const;
  // A picture slot with the picture's top-left corner at placement from the
  // control position; an empty slot for an unknown name.
  guikit::Picture slot(const std::string& name, guikit::Point placement) const;
  // The name's index in the resource list, -1 when it is not there.
  static int index_of(const std::string& name);
  // The name at an index of the resource list, empty outside it.
  static std::string name_at(int index);

 private:
  std::map<std::string, std::unique_ptr<guikit::PicDataInterface>> pictures_;
  std::map<std::string, std::unique_ptr<guikit::FontInterface>> fonts_;
  bool loaded_ = false;
};
