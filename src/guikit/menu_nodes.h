#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace guikit {

class MenuItem;

// Called when its item is chosen; knows the item it is attached to.
class MenuListenerInterface {
 public:
  virtual ~MenuListenerInterface() = default;
  virtual void on_select() = 0;
  virtual void set_item(MenuItem* item) = 0;
  virtual MenuItem* get_item() const = 0;
};

class MenuNodeInterface {
 public:
  explicit MenuNodeInterface(std::string label = std::string()) : label_(std::move(label)) {}
  virtual ~MenuNodeInterface() = default;
  const std::string& get_label() const { return label_; }
  void set_label(const std::string& label) { label_ = label; }

 protected:
  std::string label_;
};

// A choosable entry. Every item made, copies too, takes the next process-wide id.
class MenuItem : public MenuNodeInterface {
 public:
  explicit MenuItem(std::string label = std::string());
  MenuItem(const MenuItem& other);
  MenuItem& operator=(const MenuItem& other);

  int32_t get_id() const { return id_; }
  bool is_grayed() const { return grayed_; }
  void set_grayed(bool grayed) { grayed_ = grayed; }
  bool is_checked() const { return checked_; }
  void set_checked(bool checked) { checked_ = checked; }
  bool get_second_flag() const { return second_flag_; }
  void set_second_flag(bool flag) { second_flag_ = flag; }
  // Joins both ways; nullptr detaches.
  void set_listener(MenuListenerInterface* listener);
  MenuListenerInterface* get_listener() const { return listener_; }

  // Back to the state of a freshly loaded module (first id 1).
  static void reset_ids();

 private:
  int32_t id_;
  MenuListenerInterface* listener_ = nullptr;
  bool grayed_ = false;
  bool second_flag_ = true;
  bool checked_ = false;
};

// A separator, labelled or not.
class MenuDelimiter : public MenuNodeInterface {
 public:
  explicit MenuDelimiter(std::string label = std::string()) : MenuNodeInterface(std::move(label)) {}
};

// An ordered list of nodes (not owned); as a child it becomes a sub-menu.
class MenuList : public MenuNodeInterface {
 public:
  explicit MenuList(std::string label = std::string()) : MenuNodeInterface(std::move(label)) {}
  size_t add_child(MenuNodeInterface* child);
  MenuNodeInterface* get_child(size_t index) const { return index < children_.size() ? children_[index] : nullptr; }
  size_t get_child_count() const { return children_.size(); }
  void remove_all() { children_.clear(); }

 private:
  std::vector<MenuNodeInterface*> children_;
};

// Depth first, in order; nullptr when no item has the id.
MenuItem* find_menu_item(const MenuList& root, int32_t id);

// One line of the menu as a platform shows it.
struct MenuEntry {
  enum Kind { kItem, kSeparator, kLabel, kSubMenuBegin, kSubMenuEnd };
  Kind kind;
  std::string text;
  int32_t id;  // items only, else 0
  bool grayed;
  bool checked;
  int depth;
};

// The tree in display order, with the texts the platform menus use.
std::vector<MenuEntry> flatten_menu(const MenuList& root);

}  // namespace guikit
