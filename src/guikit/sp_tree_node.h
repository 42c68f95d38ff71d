#pragma once

#include <cstdint>
#include <vector>

#include "guikit/message_handler_interface.h"
#include "guikit/messages.h"
#include "guikit/rect.h"

namespace guikit {

// Base of every tree node: upward messages go to the parent, the rest down.
class SPTreeNodeInterface : public MessageHandlerInterface {
 public:
  static constexpr int32_t kUnset = INT32_MIN;

  ~SPTreeNodeInterface() override = default;
  int32_t process_message(MessageInterface& message) override;
  virtual void set_position(Point point) { position_ = point; }
  virtual void on_node_hook() {}
  virtual int32_t process_message_down(MessageInterface& message) = 0;

  Point get_position() const { return position_; }
  void set_parent(MessageHandlerInterface* parent) { parent_ = parent; }
  MessageHandlerInterface* get_parent() const { return parent_; }
  bool is_visible() const { return visible_; }
  const Rect& get_node_box() const { return node_box_; }

 protected:
  Point position_{kUnset, kUnset};
  MessageHandlerInterface* parent_ = nullptr;
  bool visible_ = false;
  Rect node_box_{-(1 << 29), -(1 << 29), (1 << 29) - 1, (1 << 29) - 1};
};

// An ordered row (horizontal) or column (vertical) of children, each with an
// extent along the split axis.
class SPTreeSplit : public virtual SPTreeNodeInterface {
 public:
  struct Child {
    SPTreeNodeInterface* node;
    int32_t extent;
  };

  explicit SPTreeSplit(bool horizontal = false) : horizontal_(horizontal) {}

  int32_t process_message_down(MessageInterface& message) override;
  void set_position(Point point) override;

  void add_child(SPTreeNodeInterface* child, int32_t extent);
  // -1 when the index is out of range.
  int32_t replace_child(size_t index, SPTreeNodeInterface* child, int32_t extent);
  size_t get_child_count() const { return children_.size(); }
  SPTreeNodeInterface* get_child(size_t index) const { return index < children_.size() ? children_[index].node : nullptr; }
  bool is_horizontal() const { return horizontal_; }
  // Stops delivery of the message in progress to further children.
  void set_consumed() { consumed_ = true; }

 private:
  Point child_position(size_t index) const;
  size_t child_index_at(int32_t coordinate) const;

  bool horizontal_;
  std::vector<Child> children_;
  bool consumed_ = false;
};

class BackgroundNodeInterface : public virtual SPTreeNodeInterface {};

class BackgroundSplit : public BackgroundNodeInterface, public SPTreeSplit {
 public:
  explicit BackgroundSplit(bool horizontal = false) : SPTreeSplit(horizontal) {}
  int32_t process_message_down(MessageInterface& message) override { return SPTreeSplit::process_message_down(message); }
  void set_position(Point point) override { SPTreeSplit::set_position(point); }
};

class CtrlGroupNodeInterface : public virtual SPTreeNodeInterface {};

class CtrlGroupSplit : public CtrlGroupNodeInterface, public SPTreeSplit {
 public:
  explicit CtrlGroupSplit(bool horizontal = false) : SPTreeSplit(horizontal) {}
  int32_t process_message_down(MessageInterface& message) override { return SPTreeSplit::process_message_down(message); }
  void set_position(Point point) override { SPTreeSplit::set_position(point); }
};

}  // namespace guikit
