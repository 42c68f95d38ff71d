#include "config/conf_key_content.h"

namespace basic {

std::string quote_conf_text(const std::string& text) {
  bool quote = text.empty() || text.find("//") != std::string::npos;
  for (char c : text) {
    if (c == ' ' || c == '\t' || c == '\n' || c == ',' || c == '=' || c == '{' || c == '}' || c == '\r' || c == '\b' ||
        c == '\v') {
      quote = true;
    }
  }
  return quote ? "\"" + text + "\"" : text;
}

void append_conf_indent(std::string& out, int level) {
  for (int i = 0; i < level; ++i) {
    out += "   ";
  }
}

int ConfKeyContentString::write_to_string(std::string& out, int level) const {
  out += quote_conf_text(text_);
  return 0;
}

std::unique_ptr<ConfKeyContentInterface> ConfKeyContentString::clone() const {
  return std::make_unique<ConfKeyContentString>(text_);
}

ConfKeyContentMulti::ConfKeyContentMulti(const ConfKeyContentMulti& other) { *this = other; }

ConfKeyContentMulti& ConfKeyContentMulti::operator=(const ConfKeyContentMulti& other) {
  if (this != &other) {
    std::vector<std::unique_ptr<ConfKeyContentInterface>> copy;
    for (const auto& content : other.contents_) {
      copy.push_back(content->clone());
    }
    contents_ = std::move(copy);
  }
  return *this;
}

int ConfKeyContentMulti::write_to_string(std::string& out, int level) const {
  out += "{ ";
  for (const auto& content : contents_) {
    const int status = content->write_to_string(out, level);
    if (status != 0) {
      return status;
    }
    out += ' ';
  }
  out += '}';
  return 0;
}

std::unique_ptr<ConfKeyContentInterface> ConfKeyContentMulti::clone() const {
  return std::make_unique<ConfKeyContentMulti>(*this);
}

}  // namespace basic
