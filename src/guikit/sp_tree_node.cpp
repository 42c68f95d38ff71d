#include "guikit/sp_tree_node.h"

namespace guikit {

int32_t SPTreeNodeInterface::process_message(MessageInterface& message) {
  if (dynamic_cast<MessageUp*>(&message)) return parent_ ? parent_->process_message(message) : -1;
  if (auto* show = dynamic_cast<ShowObject*>(&message)) visible_ = show->visible;
  return process_message_down(message);
}

Point SPTreeSplit::child_position(size_t index) const {
  int32_t along = 0;
  for (size_t i = 0; i < index && i < children_.size(); ++i) along += children_[i].extent;
  Point p = position_;
  if (horizontal_) {
    p.x += along;
  } else {
    p.y += along;
  }
  return p;
}

void SPTreeSplit::set_position(Point point) {
  position_ = point;
  for (size_t i = 0; i < children_.size(); ++i) children_[i].node->set_position(child_position(i));
}

void SPTreeSplit::add_child(SPTreeNodeInterface* child, int32_t extent) {
  if (!child) return;
  children_.push_back(Child{child, extent});
  child->set_parent(this);
  child->set_position(child_position(children_.size() - 1));
  ShowObject show(visible_);
  child->process_message(show);
}

int32_t SPTreeSplit::replace_child(size_t index, SPTreeNodeInterface* child, int32_t extent) {
  if (index >= children_.size() || !child) return -1;
  SPTreeNodeInterface* old = children_[index].node;
  ShowObject hide(false);
  old->process_message(hide);
  old->set_parent(nullptr);
  children_[index] = Child{child, extent};
  child->set_parent(this);
  // A new extent moves the children after it as well.
  for (size_t i = index; i < children_.size(); ++i) children_[i].node->set_position(child_position(i));
  ShowObject show(visible_);
  child->process_message(show);
  return 0;
}

// The first child whose far edge lies beyond the coordinate, else the last.
size_t SPTreeSplit::child_index_at(int32_t coordinate) const {
  int64_t edge = horizontal_ ? position_.x : position_.y;
  for (size_t i = 0; i < children_.size(); ++i) {
    edge += children_[i].extent;
    if (edge > coordinate) return i;
  }
  return children_.size() - 1;
}

int32_t SPTreeSplit::process_message_down(MessageInterface& message) {
  auto* down = dynamic_cast<MessageDown*>(&message);
  if (!down || children_.empty()) return -1;
  // Visibility concerns the whole subtree, whatever the area.
  if (dynamic_cast<ShowObject*>(&message)) {
    for (auto& c : children_) c.node->process_message(message);
    return 0;
  }
  const Rect& a = down->area;
  // Right and bottom are exclusive: an area's last pixel is one before them.
  // A point (mouse messages) is its own corner.
  int32_t far_x = a.right > a.left ? a.right - 1 : a.right;
  int32_t far_y = a.bottom > a.top ? a.bottom - 1 : a.bottom;
  size_t first = child_index_at(horizontal_ ? a.left : a.top);
  size_t last = child_index_at(horizontal_ ? far_x : far_y);
  consumed_ = false;
  for (size_t i = first; i <= last && i < children_.size(); ++i) {
    if (consumed_) break;
    children_[i].node->process_message(message);
  }
  return 0;
}

}  // namespace guikit
