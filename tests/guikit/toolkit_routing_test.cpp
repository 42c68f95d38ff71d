#include <gtest/gtest.h>

#include "guikit/memory_rendering_buffer.h"
#include "guikit/sp_tree_node.h"
#include "toolkit_recording_node.h"

using namespace guikit;
using guikit_test::Delivery;
using guikit_test::RecordingHandler;
using guikit_test::RecordingNode;

namespace {

std::vector<std::string> names_of_kind(const std::vector<Delivery>& log, const std::string& kind) {
  std::vector<std::string> out;
  for (const auto& d : log)
    if (d.kind == kind) out.push_back(d.node);
  return out;
}

// Three children side by side: a [10, 110), b [110, 160), c [160, 230).
struct RowTree {
  std::vector<Delivery> log;
  SPTreeSplit split{true};
  RecordingNode a{"a", &log}, b{"b", &log}, c{"c", &log};
  MemoryRenderingBuffer buffer{8, 8};
  RowTree() {
    split.set_position(Point{10, 5});
    split.add_child(&a, 100);
    split.add_child(&b, 50);
    split.add_child(&c, 70);
    log.clear();
  }
  std::vector<std::string> redraw(const Rect& area) {
    log.clear();
    Redraw r(area, buffer);
    EXPECT_EQ(0, split.process_message(r));
    return names_of_kind(log, "redraw");
  }
  std::vector<std::string> point(int32_t x, int32_t y) {
    log.clear();
    MouseMove m(x, y);
    split.process_message(m);
    return names_of_kind(log, "move");
  }
};

}  // namespace

TEST(ToolkitSplitRouting, AreasReachEveryChildTheySpanInOrder) {
  RowTree t;
  EXPECT_EQ((std::vector<std::string>{"a", "b"}), t.redraw(Rect{50, 0, 120, 40}));
  EXPECT_EQ((std::vector<std::string>{"b"}), t.redraw(Rect{115, 0, 150, 40}));
  EXPECT_EQ((std::vector<std::string>{"a", "b", "c"}), t.redraw(Rect{0, 0, 400, 40}));
  // Right edges are exclusive: an area ending where b starts stays in a.
  EXPECT_EQ((std::vector<std::string>{"a"}), t.redraw(Rect{10, 0, 110, 40}));
  EXPECT_EQ((std::vector<std::string>{"b", "c"}), t.redraw(Rect{110, 0, 161, 40}));
}

TEST(ToolkitSplitRouting, PointsGoToOneChildAndEdgesBelongToTheNext) {
  RowTree t;
  EXPECT_EQ((std::vector<std::string>{"a"}), t.point(109, 0));
  EXPECT_EQ((std::vector<std::string>{"b"}), t.point(110, 0));
  EXPECT_EQ((std::vector<std::string>{"c"}), t.point(160, 0));
  // Beyond either end: the first child whose far edge lies beyond, else the last.
  EXPECT_EQ((std::vector<std::string>{"a"}), t.point(-50, 0));
  EXPECT_EQ((std::vector<std::string>{"c"}), t.point(900, 0));
}

TEST(ToolkitSplitRouting, PositionsFollowTheExtentsAlongTheAxis) {
  std::vector<Delivery> log;
  SPTreeSplit column(false);
  RecordingNode a{"a", &log}, b{"b", &log}, c{"c", &log};
  column.add_child(&a, 30);
  column.add_child(&b, 20);
  column.set_position(Point{7, 100});
  column.add_child(&c, 5);
  EXPECT_EQ(7, a.get_position().x);
  EXPECT_EQ(100, a.get_position().y);
  EXPECT_EQ(130, b.get_position().y);
  EXPECT_EQ(150, c.get_position().y);
  EXPECT_EQ(7, c.get_position().x);
  // A replaced child with another extent moves the ones after it.
  RecordingNode d{"d", &log};
  EXPECT_EQ(0, column.replace_child(0, &d, 10));
  EXPECT_EQ(100, d.get_position().y);
  EXPECT_EQ(110, b.get_position().y);
  EXPECT_EQ(130, c.get_position().y);
  EXPECT_EQ(nullptr, a.get_parent());
  EXPECT_EQ(&column, d.get_parent());
  EXPECT_EQ(-1, column.replace_child(3, &a, 1));
}

TEST(ToolkitSplitRouting, ShowObjectReachesTheWholeTreeAndContainersPassTheirVisibility) {
  std::vector<Delivery> log;
  BackgroundSplit root(true);
  BackgroundSplit inner(false);
  RecordingNode a{"a", &log}, b{"b", &log}, c{"c", &log};
  inner.add_child(&b, 10);
  inner.add_child(&c, 10);
  EXPECT_FALSE(b.is_visible());
  root.add_child(&a, 50);
  root.add_child(&inner, 50);
  EXPECT_FALSE(c.is_visible());

  ShowObject show(true);
  root.process_message(show);
  EXPECT_TRUE(root.is_visible());
  EXPECT_TRUE(a.is_visible());
  EXPECT_TRUE(inner.is_visible());
  EXPECT_TRUE(b.is_visible());
  EXPECT_TRUE(c.is_visible());

  // Added to a visible split, a node is shown at once; replaced, it is hidden.
  RecordingNode d{"d", &log};
  inner.add_child(&d, 10);
  EXPECT_TRUE(d.is_visible());
  RecordingNode e{"e", &log};
  inner.replace_child(2, &e, 10);
  EXPECT_FALSE(d.is_visible());
  EXPECT_TRUE(e.is_visible());

  ShowObject hide(false);
  root.process_message(hide);
  EXPECT_FALSE(a.is_visible());
  EXPECT_FALSE(e.is_visible());
}

TEST(ToolkitSplitRouting, UpwardMessagesClimbToTheTopHandler) {
  std::vector<Delivery> log;
  RecordingHandler top(&log, "top");
  CtrlGroupSplit root(true);
  CtrlGroupSplit inner(false);
  RecordingNode leaf{"leaf", &log};
  inner.add_child(&leaf, 10);
  root.add_child(&inner, 10);

  TextInputStop orphan(true);
  EXPECT_EQ(-1, leaf.send_up(orphan)) << "without a top handler the climb ends in -1";

  root.set_parent(&top);
  MenuStop stop;
  log.clear();
  EXPECT_EQ(0, leaf.send_up(stop));
  ASSERT_EQ(1u, log.size());
  EXPECT_EQ("top", log[0].node);
  EXPECT_EQ("other", log[0].kind);
}

TEST(ToolkitSplitRouting, ASplitWithoutChildrenAnswersNotHandled) {
  SPTreeSplit empty(true);
  MemoryRenderingBuffer buffer(4, 4);
  Redraw r(Rect{0, 0, 4, 4}, buffer);
  EXPECT_EQ(-1, empty.process_message(r));
}

TEST(ToolkitTimerIds, EachSetTimerTakesTheNextIdAtConstruction) {
  int32_t first = 0;
  int32_t second = 0;
  SetTimer a(0.03f, nullptr, &first);
  SetTimer b(0.03f, nullptr, &second);
  EXPECT_EQ(first + 1, second);
  EXPECT_EQ(first, a.timer_id);
  SetTimer::reset_ids();
  int32_t after_reset = 0;
  SetTimer c(0.1f, nullptr, &after_reset);
  EXPECT_EQ(1, after_reset);
}
