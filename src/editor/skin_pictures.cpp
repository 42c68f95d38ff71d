#include "editor/skin_pictures.h"

#include "guikit/font_factory.h"
#include "guikit/pic_data_factory.h"
#include "skin/skin_anchors.h"

namespace {
constexpr int kFontKind = 2;
}

bool SkinPictures::load_all() {
  bool complete = true;
  for (const SkinResource& resource : kSkinResources) {
    const std::string name = resource.name;
    if (resource.kind == kFontKind) {
      if (fonts_.count(name) == 0) {
        std::unique_ptr<guikit::FontInterface> font = guikit::FontFactory::instance().create_font(resource.name);
        if (font == nullptr) {
          complete = false;
          continue;
        }
        fonts_[name] = std::move(font);
      }
    } else if (pictures_.count(name) == 0) {
      std::unique_ptr<guikit::PicDataInterface> pic = guikit::PicDataFactory::instance().create_picture(resource.name);
      if (pic == nullptr) {
        complete = false;
        continue;
      }
      pictures_[name] = std::move(pic);
    }
  }
  loaded_ = complete;
  return complete;
}

guikit::PicDataInterface* SkinPictures::get(const std::string& name) const {
  auto it = pictures_.find(name);
  return it == pictures_.end() ? nullptr : it->second.get();
}

const guikit::FontInterface* SkinPictures::get_font(const std::string& name) const {
  auto it = fonts_.find(name);
  return it == fonts_.end() ? nullptr : it->second.get();
}

guikit::Picture SkinPictures::slot(const std::string& name, guikit::Point placement) const {
  guikit::PicDataInterface* pic = get(name);
  return pic == nullptr ? guikit::Picture() : guikit::Picture(pic, placement);
}

int SkinPictures::index_of(const std::string& name) {
  for (int i = 0; i < kSkinResourceCount; ++i) {
    if (name == kSkinResources[i].name) return i;
  }
  return -1;
}

std::string SkinPictures::name_at(int index) {
  return index >= 0 && index < kSkinResourceCount ? kSkinResources[index].name : std::string();
}
