#include "config/conf_key.h"

#include <stdexcept>

namespace basic {

ConfKeyInterface::ConfKeyInterface(const std::string& name) {
  check_name_throw(name);
  name_ = name;
}

void ConfKeyInterface::set_name(const std::string& name) {
  check_name_throw(name);
  name_ = name;
}

void ConfKeyInterface::check_name_throw(const std::string& name) {
  if (name.find('/') != std::string::npos || name.find('\\') != std::string::npos) {
    throw std::runtime_error("basic::ConfKeyInterface::check_name_throw() : Invalid name.");
  }
}

std::string ConfKeyInterface::make_valid_name(const std::string& text) {
  std::string name = text;
  for (char& c : name) {
    const bool letter = (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z');
    const bool digit = c >= '0' && c <= '9';
    if (!letter && !digit) {
      c = '_';
    }
  }
  return name;
}

int ConfKeyInterface::write_to_string(std::string& out, int level) const {
  if (name_.empty()) {
    throw std::runtime_error("basic::ConfKeyInterface::do_write_to_string() : Key can't be anonymous.");
  }
  return do_write_to_string(out, level);
}

// ---- Data keys -------------------------------------------------------------------

ConfKeyData::ConfKeyData(const std::string& name) : ConfKeyInterface(name), content_(new ConfKeyContentString) {}

ConfKeyData::ConfKeyData(const std::string& name, const std::string& text)
    : ConfKeyInterface(name), content_(new ConfKeyContentString(text)) {}

ConfKeyData::ConfKeyData(const ConfKeyData& other) : ConfKeyInterface(other), content_(other.content_->clone()) {}

ConfKeyData& ConfKeyData::operator=(const ConfKeyData& other) {
  if (this != &other) {
    ConfKeyInterface::operator=(other);
    content_ = other.content_->clone();
  }
  return *this;
}

void ConfKeyData::adopt_content(std::unique_ptr<ConfKeyContentInterface> content) {
  if (content) {
    content_ = std::move(content);
  }
}

std::unique_ptr<ConfKeyInterface> ConfKeyData::clone() const { return std::make_unique<ConfKeyData>(*this); }

int ConfKeyData::do_write_to_string(std::string& out, int level) const {
  append_conf_indent(out, level);
  out += quote_conf_text(get_name());
  out += " = ";
  const int status = content_->write_to_string(out, level);
  if (status != 0) {
    return status;
  }
  if (!get_comment().empty()) {
    out += "\t// ";
    out += get_comment();
  }
  return 0;
}

// ---- Multi keys ------------------------------------------------------------------

ConfKeyMulti::ConfKeyMulti(const std::string& name) : ConfKeyInterface(name) {}

ConfKeyMulti::ConfKeyMulti(const ConfKeyMulti& other) : ConfKeyInterface(other) {
  for (const auto& key : other.keys_) {
    keys_.push_back(key->clone());
  }
}

ConfKeyMulti& ConfKeyMulti::operator=(const ConfKeyMulti& other) {
  if (this != &other) {
    ConfKeyMulti copy(other);
    ConfKeyInterface::operator=(other);
    keys_ = std::move(copy.keys_);
  }
  return *this;
}

std::unique_ptr<ConfKeyInterface> ConfKeyMulti::clone() const { return std::make_unique<ConfKeyMulti>(*this); }

int ConfKeyMulti::do_write_to_string(std::string& out, int level) const {
  if (!get_comment().empty()) {
    append_conf_indent(out, level);
    out += "// ";
    out += get_comment();
    out += '\n';
  }
  append_conf_indent(out, level);
  out += quote_conf_text(get_name());
  out += " =\n";
  append_conf_indent(out, level);
  out += "{\n";
  for (const auto& key : keys_) {
    const int status = key->write_to_string(out, level + 1);
    if (status != 0) {
      return status;
    }
    out += '\n';
  }
  append_conf_indent(out, level);
  out += '}';
  return 0;
}

void ConfKeyMulti::set_key(const ConfKeyInterface& key) {
  for (auto& child : keys_) {
    if (child->get_name() == key.get_name()) {
      child = key.clone();
      return;
    }
  }
  keys_.push_back(key.clone());
}

std::pair<std::string, std::string> ConfKeyMulti::split_key_path_first(const std::string& path) {
  const size_t separator = path.find_first_of("/\\");
  std::pair<std::string, std::string> parts;
  if (separator == std::string::npos) {
    parts.first = path;
  } else {
    parts.first = path.substr(0, separator);
    parts.second = path.substr(separator + 1);
  }
  if (parts.first.empty()) {
    throw std::runtime_error("basic::ConfKeyMulti::split_key_path_first() : Invalid key path.");
  }
  return parts;
}

const ConfKeyInterface* ConfKeyMulti::find_key(const std::string& path) const {
  const auto parts = split_key_path_first(path);
  for (const auto& child : keys_) {
    if (child->get_name() != parts.first) {
      continue;
    }
    if (parts.second.empty()) {
      return child.get();
    }
    const auto* multi = dynamic_cast<const ConfKeyMulti*>(child.get());
    return multi != nullptr ? multi->find_key(parts.second) : nullptr;
  }
  return nullptr;
}

int ConfKeyMulti::find_multi(const std::string& name, int start) const {
  for (int i = start < 0 ? 0 : start; i < get_nbr_keys(); ++i) {
    const auto& child = keys_[static_cast<size_t>(i)];
    if (child->get_name() == name && dynamic_cast<const ConfKeyMulti*>(child.get()) != nullptr) {
      return i;
    }
  }
  return -1;
}

std::string ConfKeyMulti::get_string(const std::string& path) const {
  const auto* data = dynamic_cast<const ConfKeyData*>(find_key(path));
  if (data == nullptr) {
    return std::string();
  }
  const auto* text = dynamic_cast<const ConfKeyContentString*>(&data->use_content());
  return text != nullptr ? text->get_string() : std::string();
}

}  // namespace basic
