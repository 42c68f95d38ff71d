#include <gtest/gtest.h>

#include "guikit/headless/offscreen_window.h"
#include "guikit/menu_nodes.h"
#include "guikit/messages.h"

using namespace guikit;

namespace {

class CountingListener : public MenuListenerInterface {
 public:
  void on_select() override { ++selected; }
  void set_item(MenuItem* item) override { item_ = item; }
  MenuItem* get_item() const override { return item_; }
  int selected = 0;

 private:
  MenuItem* item_ = nullptr;
};

}  // namespace

TEST(MenuIds, ItemsAndTheirCopiesTakeConsecutiveIds) {
  MenuItem a("a");
  MenuItem b("b");
  EXPECT_EQ(a.get_id() + 1, b.get_id());
  MenuItem copy(a);
  EXPECT_EQ(b.get_id() + 1, copy.get_id());
  EXPECT_EQ("a", copy.get_label());
  MenuItem assigned("z");
  int32_t id = assigned.get_id();
  assigned = b;
  EXPECT_EQ(id, assigned.get_id()) << "assignment copies contents, not identity";
  EXPECT_TRUE(a.get_second_flag());
  EXPECT_FALSE(a.is_grayed());
  EXPECT_FALSE(a.is_checked());
}

TEST(MenuIds, ListenerAndItemKnowEachOther) {
  MenuItem item("x");
  CountingListener l;
  item.set_listener(&l);
  EXPECT_EQ(&l, item.get_listener());
  EXPECT_EQ(&item, l.get_item());
}

TEST(MenuTree, FlattenedTextsFollowThePlatformRules) {
  MenuList root;
  MenuItem plain("Load bank");
  MenuItem grey(std::string(200, 'w'));
  grey.set_grayed(true);
  grey.set_checked(true);
  MenuDelimiter line;
  MenuDelimiter word("MIDI");
  MenuDelimiter long_label(std::string(130, 'L'));
  MenuList sub("Ports");
  MenuItem inner("In 1");
  sub.add_child(&inner);
  EXPECT_EQ(1u, root.add_child(&plain));
  root.add_child(&grey);
  root.add_child(&line);
  root.add_child(&word);
  root.add_child(&long_label);
  EXPECT_EQ(6u, root.add_child(&sub));

  auto e = flatten_menu(root);
  ASSERT_EQ(8u, e.size());
  EXPECT_EQ(MenuEntry::kItem, e[0].kind);
  EXPECT_EQ("Load bank", e[0].text);
  EXPECT_EQ(plain.get_id(), e[0].id);
  EXPECT_EQ(127u, e[1].text.size());
  EXPECT_TRUE(e[1].grayed);
  EXPECT_TRUE(e[1].checked);
  EXPECT_EQ(MenuEntry::kSeparator, e[2].kind);
  EXPECT_EQ(MenuEntry::kLabel, e[3].kind);
  EXPECT_EQ("--- MIDI ", e[3].text);
  EXPECT_TRUE(e[3].grayed);
  EXPECT_EQ("--- " + std::string(123, 'L'), e[4].text) << "long labels are cut and not padded";
  EXPECT_EQ(MenuEntry::kSubMenuBegin, e[5].kind);
  EXPECT_EQ("Ports", e[5].text);
  EXPECT_EQ(1, e[6].depth);
  EXPECT_EQ("In 1", e[6].text);
  EXPECT_EQ(MenuEntry::kSubMenuEnd, e[7].kind);

  EXPECT_EQ(&inner, find_menu_item(root, inner.get_id()));
  EXPECT_EQ(nullptr, find_menu_item(root, inner.get_id() + 1000));
  root.remove_all();
  EXPECT_EQ(0u, root.get_child_count());
}

TEST(MenuShow, ChoosingByIdCallsOnlyThatItemsListener) {
  OffscreenWindow w(Size{50, 50});
  MenuList root;
  MenuList sub("more");
  MenuItem a("a"), b("b"), grey("grey");
  grey.set_grayed(true);
  CountingListener la, lb, lg;
  a.set_listener(&la);
  b.set_listener(&lb);
  grey.set_listener(&lg);
  root.add_child(&a);
  root.add_child(&sub);
  sub.add_child(&b);
  sub.add_child(&grey);

  w.menu().choose_next(b.get_id());
  MenuRequest req(&root, 0, 0);
  EXPECT_EQ(0, w.process_message(req));
  EXPECT_EQ(0, la.selected);
  EXPECT_EQ(1, lb.selected);

  // Nothing chosen (escape), then a grayed item: no listener runs.
  EXPECT_EQ(0, w.process_message(req));
  w.menu().choose_next(grey.get_id());
  EXPECT_EQ(0, w.process_message(req));
  EXPECT_EQ(1, lb.selected);
  EXPECT_EQ(0, lg.selected);
  EXPECT_EQ(3, w.menu().get_show_count());

  MenuList empty;
  MenuRequest none(&empty);
  EXPECT_EQ(0, w.process_message(none));
  EXPECT_TRUE(w.menu().get_last_entries().empty());
  MenuRequest broken(nullptr);
  EXPECT_EQ(-1, w.process_message(broken));
  MenuStop stop;
  EXPECT_EQ(0, w.process_message(stop));
}
