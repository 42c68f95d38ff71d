#pragma once

#include <array>

#include "guikit/background_item.h"
#include "guikit/ctrl_group_item.h"
#include "guikit/rect.h"
#include "guikit/sp_tree_node.h"

class SkinPictures;

// The editor surface as two trees of the same shape: the background pictures and
// the control groups. Rows from the top: the master column beside the split strip
// over the four bands, then the edit, presets and info panels.
class EditorTrees {
 public:
  static constexpr int kNbrBands = 4;

  EditorTrees();
  EditorTrees(const EditorTrees&) = delete;
  EditorTrees& operator=(const EditorTrees&) = delete;

  // Registers the pictures with the background leaves and joins both trees.
  void build(const SkinPictures& pictures);
  bool is_built() const { return built_; }

  guikit::SPTreeNodeInterface& background_root() { return bkg_root_; }
  guikit::SPTreeNodeInterface& control_root() { return ctl_root_; }
  void set_parent(guikit::MessageHandlerInterface* window);
  void show(bool visible);

  guikit::CtrlGroupItem& master_group() { return master_; }
  guikit::CtrlGroupItem& top_group() { return top_; }
  guikit::CtrlGroupItem& band_group(int band) { return bands_[static_cast<size_t>(band)]; }
  guikit::CtrlGroupItem& edit_group() { return edit_; }
  guikit::CtrlGroupItem& presets_group() { return presets_; }
  guikit::CtrlGroupItem& info_group() { return info_; }

  // Bands 1..3 swap their page for the tip page while they are off; band 0 stays.
  // Answers the editor area of the band's page.
  guikit::Rect show_band_page(int band, bool shown);
  bool is_band_page_shown(int band) const { return page_shown_[static_cast<size_t>(band)]; }
  static guikit::Rect band_area(int band);

 private:
  // Background: root (column) = upper row + lower row.
  guikit::BackgroundSplit bkg_root_{false};
  guikit::BackgroundSplit bkg_upper_{true};
  guikit::BackgroundSplit bkg_right_{false};
  guikit::BackgroundSplit bkg_bands_{true};
  guikit::BackgroundSplit bkg_lower_{true};
  guikit::BackgroundItem master_pic_, top_pic_, edit_pic_, presets_pic_, info_pic_;
  std::array<guikit::BackgroundItem, kNbrBands> band_pics_;
  std::array<guikit::BackgroundItem, kNbrBands> tip_pics_;  // [0] unused: band 1 has no tip page

  // Controls, the same shape.
  guikit::CtrlGroupSplit ctl_root_{false};
  guikit::CtrlGroupSplit ctl_upper_{true};
  guikit::CtrlGroupSplit ctl_right_{false};
  guikit::CtrlGroupSplit ctl_bands_{true};
  guikit::CtrlGroupSplit ctl_lower_{true};
  guikit::CtrlGroupItem master_, top_, edit_, presets_, info_;
  std::array<guikit::CtrlGroupItem, kNbrBands> bands_;

  std::array<bool, kNbrBands> page_shown_{{true, true, true, true}};
  bool built_ = false;
};
