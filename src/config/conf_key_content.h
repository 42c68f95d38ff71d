#pragma once

#include <memory>
#include <string>
#include <vector>

namespace basic {

// Root of the value classes of the configuration tree.
class ConfKeyContentInterface {
 public:
  virtual ~ConfKeyContentInterface() = default;
  virtual int write_to_string(std::string& out, int level) const = 0;
  virtual std::unique_ptr<ConfKeyContentInterface> clone() const = 0;
};

// One text.
class ConfKeyContentString : public ConfKeyContentInterface {
 public:
  ConfKeyContentString() = default;
  explicit ConfKeyContentString(std::string text) : text_(std::move(text)) {}
  int write_to_string(std::string& out, int level) const override;
  std::unique_ptr<ConfKeyContentInterface> clone() const override;
  void set_string(const std::string& text) { text_ = text; }
  const std::string& get_string() const { return text_; }

 private:
  std::string text_;
};

// An ordered list of values, which may nest.
class ConfKeyContentMulti : public ConfKeyContentInterface {
 public:
  ConfKeyContentMulti() = default;
  ConfKeyContentMulti(const ConfKeyContentMulti& other);
  ConfKeyContentMulti& operator=(const ConfKeyContentMulti& other);
  int write_to_string(std::string& out, int level) const override;
  std::unique_ptr<ConfKeyContentInterface> clone() const override;
  void add_content(const ConfKeyContentInterface& content) { contents_.push_back(content.clone()); }
  void adopt_content(std::unique_ptr<ConfKeyContentInterface> content) { contents_.push_back(std::move(content)); }
  int get_nbr_contents() const { return static_cast<int>(contents_.size()); }
  const ConfKeyContentInterface& use_content(int index) const { return *contents_.at(static_cast<size_t>(index)); }

 private:
  std::vector<std::unique_ptr<ConfKeyContentInterface>> contents_;
};

// Texts holding a space, tab, line feed or comma are written between double
// quotes; so are empty texts and texts with '=', braces, "//" or the other
// characters the reader splits at, which would not read back unchanged when bare. There is no escape character, so a text
// holding a double quote cannot be written faithfully at all.
std::string quote_conf_text(const std::string& text);

// Three spaces per level.
void append_conf_indent(std::string& out, int level);

}  // namespace basic
