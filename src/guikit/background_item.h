#pragma once

#include "guikit/picture.h"
#include "guikit/sp_tree_node.h"

namespace guikit {

// A leaf of the background tree: paints one picture at the node's position.
class BackgroundItem : public BackgroundNodeInterface, public Picture {
 public:
  BackgroundItem() = default;
  explicit BackgroundItem(PicDataInterface* pic) : Picture(pic, Point{0, 0}) {}
  int32_t process_message_down(MessageInterface& message) override;
};

}  // namespace guikit
