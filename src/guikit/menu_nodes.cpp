#include "guikit/menu_nodes.h"

#include <atomic>

namespace guikit {

namespace {
std::atomic<int32_t> g_last_menu_id{0};
int32_t next_menu_id() { return g_last_menu_id.fetch_add(1, std::memory_order_relaxed) + 1; }

// Platform menus limit entry texts.
constexpr size_t kItemTextMax = 127;
constexpr size_t kDelimiterLabelMax = 123;
constexpr size_t kDelimiterPadBelow = 40;

void flatten_into(const MenuList& list, int depth, std::vector<MenuEntry>& out) {
  for (size_t i = 0; i < list.get_child_count(); ++i) {
    const MenuNodeInterface* node = list.get_child(i);
    if (auto* sub = dynamic_cast<const MenuList*>(node)) {
      out.push_back(MenuEntry{MenuEntry::kSubMenuBegin, sub->get_label().substr(0, kItemTextMax), 0, false, false, depth});
      flatten_into(*sub, depth + 1, out);
      out.push_back(MenuEntry{MenuEntry::kSubMenuEnd, std::string(), 0, false, false, depth});
    } else if (auto* item = dynamic_cast<const MenuItem*>(node)) {
      out.push_back(MenuEntry{MenuEntry::kItem, item->get_label().substr(0, kItemTextMax), item->get_id(),
                              item->is_grayed(), item->is_checked(), depth});
    } else if (auto* delimiter = dynamic_cast<const MenuDelimiter*>(node)) {
      if (delimiter->get_label().empty()) {
        out.push_back(MenuEntry{MenuEntry::kSeparator, std::string(), 0, false, false, depth});
      } else {
        std::string text = "--- " + delimiter->get_label().substr(0, kDelimiterLabelMax);
        if (text.size() < kDelimiterPadBelow) text += ' ';
        out.push_back(MenuEntry{MenuEntry::kLabel, text, 0, true, false, depth});
      }
    }
  }
}

}  // namespace

MenuItem::MenuItem(std::string label) : MenuNodeInterface(std::move(label)), id_(next_menu_id()) {}

MenuItem::MenuItem(const MenuItem& other)
    : MenuNodeInterface(other),
      id_(next_menu_id()),
      listener_(nullptr),
      grayed_(other.grayed_),
      second_flag_(other.second_flag_),
      checked_(other.checked_) {}

// The id stays: it names this object, not its contents.
MenuItem& MenuItem::operator=(const MenuItem& other) {
  label_ = other.label_;
  grayed_ = other.grayed_;
  second_flag_ = other.second_flag_;
  checked_ = other.checked_;
  return *this;
}

void MenuItem::set_listener(MenuListenerInterface* listener) {
  listener_ = listener;
  if (listener_) listener_->set_item(this);
}

void MenuItem::reset_ids() { g_last_menu_id.store(0, std::memory_order_relaxed); }

size_t MenuList::add_child(MenuNodeInterface* child) {
  if (child) children_.push_back(child);
  return children_.size();
}

MenuItem* find_menu_item(const MenuList& root, int32_t id) {
  for (size_t i = 0; i < root.get_child_count(); ++i) {
    MenuNodeInterface* node = root.get_child(i);
    if (auto* item = dynamic_cast<MenuItem*>(node)) {
      if (item->get_id() == id) return item;
    } else if (auto* sub = dynamic_cast<MenuList*>(node)) {
      if (MenuItem* found = find_menu_item(*sub, id)) return found;
    }
  }
  return nullptr;
}

std::vector<MenuEntry> flatten_menu(const MenuList& root) {
  std::vector<MenuEntry> out;
  flatten_into(root, 0, out);
  return out;
}

}  // namespace guikit
