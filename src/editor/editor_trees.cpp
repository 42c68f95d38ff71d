#include "editor/editor_trees.h"

#include "editor/skin_pictures.h"
#include "guikit/messages.h"

namespace {

constexpr int kMasterWidth = 147;
constexpr int kRightWidth = 462;
constexpr int kUpperHeight = 229;
constexpr int kLowerHeight = 53;
constexpr int kTopHeight = 36;
constexpr int kBandHeight = 193;
constexpr int kBandWidth[EditorTrees::kNbrBands] = {115, 114, 114, 119};
constexpr int kLowerWidth[3] = {117, 239, 253};
const char* const kBandPicture[EditorTrees::kNbrBands] = {"bkg_24_band1", "bkg_24_band2", "bkg_24_band3",
                                                           "bkg_24_band4"};
const char* const kTipPicture[EditorTrees::kNbrBands] = {nullptr, "bkg_24_tip1", "bkg_24_tip2pc", "bkg_24_tip3"};

void use_picture(guikit::BackgroundItem& item, const SkinPictures& pictures, const char* name) {
  item.set(pictures.get(name), guikit::Point{0, 0});
}

}  // namespace

EditorTrees::EditorTrees() = default;

void EditorTrees::build(const SkinPictures& pictures) {
  if (built_) return;
  // Registered in the skin's order: top, master, tip pages, bands, lower panels.
  use_picture(top_pic_, pictures, "bkg_24_top");
  use_picture(master_pic_, pictures, "bkg_24_master");
  for (int b = 1; b < kNbrBands; ++b) use_picture(tip_pics_[static_cast<size_t>(b)], pictures, kTipPicture[b]);
  for (int b = 0; b < kNbrBands; ++b) use_picture(band_pics_[static_cast<size_t>(b)], pictures, kBandPicture[b]);
  use_picture(edit_pic_, pictures, "bkg_24_edit");
  use_picture(presets_pic_, pictures, "bkg_24_presets");
  use_picture(info_pic_, pictures, "bkg_24_info");

  for (int b = 0; b < kNbrBands; ++b) {
    bkg_bands_.add_child(&band_pics_[static_cast<size_t>(b)], kBandWidth[b]);
    ctl_bands_.add_child(&bands_[static_cast<size_t>(b)], kBandWidth[b]);
  }
  bkg_right_.add_child(&top_pic_, kTopHeight);
  bkg_right_.add_child(&bkg_bands_, kBandHeight);
  ctl_right_.add_child(&top_, kTopHeight);
  ctl_right_.add_child(&ctl_bands_, kBandHeight);
  bkg_upper_.add_child(&master_pic_, kMasterWidth);
  bkg_upper_.add_child(&bkg_right_, kRightWidth);
  ctl_upper_.add_child(&master_, kMasterWidth);
  ctl_upper_.add_child(&ctl_right_, kRightWidth);
  bkg_lower_.add_child(&edit_pic_, kLowerWidth[0]);
  bkg_lower_.add_child(&presets_pic_, kLowerWidth[1]);
  bkg_lower_.add_child(&info_pic_, kLowerWidth[2]);
  ctl_lower_.add_child(&edit_, kLowerWidth[0]);
  ctl_lower_.add_child(&presets_, kLowerWidth[1]);
  ctl_lower_.add_child(&info_, kLowerWidth[2]);
  bkg_root_.add_child(&bkg_upper_, kUpperHeight);
  bkg_root_.add_child(&bkg_lower_, kLowerHeight);
  ctl_root_.add_child(&ctl_upper_, kUpperHeight);
  ctl_root_.add_child(&ctl_lower_, kLowerHeight);
  bkg_root_.set_position(guikit::Point{0, 0});
  ctl_root_.set_position(guikit::Point{0, 0});
  built_ = true;
}

void EditorTrees::set_parent(guikit::MessageHandlerInterface* window) {
  bkg_root_.set_parent(window);
  ctl_root_.set_parent(window);
}

void EditorTrees::show(bool visible) {
  guikit::ShowObject message(visible);
  bkg_root_.process_message(message);
  ctl_root_.process_message(message);
}

guikit::Rect EditorTrees::band_area(int band) {
  int left = kMasterWidth;
  for (int b = 0; b < band && b < kNbrBands; ++b) left += kBandWidth[b];
  return guikit::Rect{left, kTopHeight, left + kBandWidth[band], kTopHeight + kBandHeight};
}

guikit::Rect EditorTrees::show_band_page(int band, bool shown) {
  if (band <= 0 || band >= kNbrBands) return guikit::Rect{};
  const size_t b = static_cast<size_t>(band);
  if (page_shown_[b] != shown) {
    page_shown_[b] = shown;
    guikit::BackgroundItem& page = shown ? band_pics_[b] : tip_pics_[b];
    bkg_bands_.replace_child(b, &page, kBandWidth[band]);
  }
  return band_area(band);
}
