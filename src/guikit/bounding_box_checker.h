#pragma once

#include <cstdint>

#include "guikit/rect.h"

namespace guikit {

// A custom hit test for shapes that are not rectangles.
class InsideCheckerInterface {
 public:
  virtual ~InsideCheckerInterface() = default;
  virtual bool is_inside(Point point) const = 0;
};

// Hit-test base of controls and pictures: a rectangle, or a custom checker when one is set.
class BoundingBoxDefaultChecker {
 public:
  static constexpr int32_t kUnset = INT32_MIN;

  virtual ~BoundingBoxDefaultChecker() = default;

  virtual bool is_inside(Point point) const {
    if (checker_) return checker_->is_inside(point);
    return point.x >= box_.left && point.x < box_.right && point.y >= box_.top && point.y < box_.bottom;
  }

  void set_bounding_box(const Rect& box) { box_ = box; }
  const Rect& get_bounding_box() const { return box_; }
  void set_checker(const InsideCheckerInterface* checker) { checker_ = checker; }

 protected:
  Rect box_{kUnset, kUnset, kUnset, kUnset};
  const InsideCheckerInterface* checker_ = nullptr;
};

}  // namespace guikit
