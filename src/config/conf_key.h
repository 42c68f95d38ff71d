#pragma once

#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "config/conf_key_content.h"

namespace basic {

// Root of the key classes.
class ConfKeyStreamInterface {
 public:
  virtual ~ConfKeyStreamInterface() = default;
};

// A named key with an optional comment. Names never hold '/' or '\', which
// separate the parts of a key path.
class ConfKeyInterface : public ConfKeyStreamInterface {
 public:
  explicit ConfKeyInterface(const std::string& name);
  ~ConfKeyInterface() override = default;

  // Throws std::runtime_error for an anonymous key.
  virtual int write_to_string(std::string& out, int level) const;
  virtual std::unique_ptr<ConfKeyInterface> clone() const = 0;
  virtual int do_write_to_string(std::string& out, int level) const = 0;

  void set_name(const std::string& name);
  const std::string& get_name() const { return name_; }
  void set_comment(const std::string& comment) { comment_ = comment; }
  const std::string& get_comment() const { return comment_; }

  // Throws std::runtime_error when name holds a path separator.
  static void check_name_throw(const std::string& name);
  // Every character other than an ASCII letter or digit becomes '_'.
  static std::string make_valid_name(const std::string& text);

 private:
  std::string name_;
  std::string comment_;
};

// A key holding one value (a text or a list).
class ConfKeyData : public ConfKeyInterface {
 public:
  explicit ConfKeyData(const std::string& name);
  ConfKeyData(const std::string& name, const std::string& text);
  ConfKeyData(const ConfKeyData& other);
  ConfKeyData& operator=(const ConfKeyData& other);

  std::unique_ptr<ConfKeyInterface> clone() const override;
  int do_write_to_string(std::string& out, int level) const override;

  void set_content(const ConfKeyContentInterface& content) { content_ = content.clone(); }
  void adopt_content(std::unique_ptr<ConfKeyContentInterface> content);
  const ConfKeyContentInterface& use_content() const { return *content_; }

 private:
  std::unique_ptr<ConfKeyContentInterface> content_;
};

// A key holding an ordered list of child keys.
class ConfKeyMulti : public ConfKeyInterface {
 public:
  explicit ConfKeyMulti(const std::string& name);
  ConfKeyMulti(const ConfKeyMulti& other);
  ConfKeyMulti& operator=(const ConfKeyMulti& other);

  std::unique_ptr<ConfKeyInterface> clone() const override;
  int do_write_to_string(std::string& out, int level) const override;

  void add_key(const ConfKeyInterface& key) { keys_.push_back(key.clone()); }
  void adopt_key(std::unique_ptr<ConfKeyInterface> key) { keys_.push_back(std::move(key)); }
  // Replaces the first child of the same name in place, or appends.
  void set_key(const ConfKeyInterface& key);
  // Child names joined by '/' or '\'; null when nothing matches.
  // Throws std::runtime_error for a path with an empty first part.
  const ConfKeyInterface* find_key(const std::string& path) const;
  // Index of the first multi key of this name at or after start, or -1.
  int find_multi(const std::string& name, int start = 0) const;
  // Text of the data key at path, or empty when there is none or it holds a list.
  std::string get_string(const std::string& path) const;
  int get_nbr_keys() const { return static_cast<int>(keys_.size()); }
  const ConfKeyInterface& use_key(int index) const { return *keys_.at(static_cast<size_t>(index)); }

  // (first, rest) of a key path; throws std::runtime_error for an empty first part.
  static std::pair<std::string, std::string> split_key_path_first(const std::string& path);

 private:
  std::vector<std::unique_ptr<ConfKeyInterface>> keys_;
};

}  // namespace basic
