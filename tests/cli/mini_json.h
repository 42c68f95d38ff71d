// A strict little JSON reader for checking the host's --json output: it
// rejects anything that is not valid JSON, so escaping mistakes show up.
#pragma once

#include <cstdlib>
#include <map>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

namespace cli_test {

struct JsonValue {
  enum class Kind { null, boolean, number, string, array, object } kind = Kind::null;
  bool boolean = false;
  double number = 0.0;
  std::string text;
  std::vector<JsonValue> items;
  std::map<std::string, JsonValue> members;

  const JsonValue& operator[](const std::string& key) const {
    const auto found = members.find(key);
    if (kind != Kind::object || found == members.end()) {
      throw std::runtime_error("no member " + key);
    }
    return found->second;
  }
  const JsonValue& operator[](size_t index) const {
    if (kind != Kind::array || index >= items.size()) throw std::runtime_error("no item");
    return items[index];
  }
};

class JsonReader {
 public:
  explicit JsonReader(const std::string& text) : text_(text) {}

  JsonValue parse_document() {
    JsonValue value = parse_value();
    skip_blanks();
    if (pos_ != text_.size()) fail("trailing characters");
    return value;
  }

 private:
  [[noreturn]] void fail(const std::string& why) {
    throw std::runtime_error("invalid JSON at " + std::to_string(pos_) + ": " + why);
  }
  void skip_blanks() {
    while (pos_ < text_.size() && (text_[pos_] == ' ' || text_[pos_] == '\n' ||
                                   text_[pos_] == '\r' || text_[pos_] == '\t')) {
      ++pos_;
    }
  }
  bool take(char c) {
    skip_blanks();
    if (pos_ < text_.size() && text_[pos_] == c) {
      ++pos_;
      return true;
    }
    return false;
  }
  void expect(char c) {
    if (!take(c)) fail(std::string("expected ") + c);
  }
  bool take_word(const char* word) {
    const std::string w(word);
    if (text_.compare(pos_, w.size(), w) == 0) {
      pos_ += w.size();
      return true;
    }
    return false;
  }
  static void append_utf8(std::string& out, unsigned code) {
    if (code < 0x80) {
      out += static_cast<char>(code);
    } else if (code < 0x800) {
      out += static_cast<char>(0xC0 | (code >> 6));
      out += static_cast<char>(0x80 | (code & 0x3F));
    } else {
      out += static_cast<char>(0xE0 | (code >> 12));
      out += static_cast<char>(0x80 | ((code >> 6) & 0x3F));
      out += static_cast<char>(0x80 | (code & 0x3F));
    }
  }
  std::string parse_string() {
    expect('"');
    std::string out;
    while (true) {
      if (pos_ >= text_.size()) fail("unterminated string");
      const unsigned char c = static_cast<unsigned char>(text_[pos_++]);
      if (c == '"') return out;
      if (c < 0x20) fail("raw control character in string");
      if (c != '\\') {
        out += static_cast<char>(c);
        continue;
      }
      if (pos_ >= text_.size()) fail("dangling escape");
      const char e = text_[pos_++];
      switch (e) {
        case '"': out += '"'; break;
        case '\\': out += '\\'; break;
        case '/': out += '/'; break;
        case 'b': out += '\b'; break;
        case 'f': out += '\f'; break;
        case 'n': out += '\n'; break;
        case 'r': out += '\r'; break;
        case 't': out += '\t'; break;
        case 'u': {
          if (pos_ + 4 > text_.size()) fail("short \\u escape");
          const std::string hex = text_.substr(pos_, 4);
          char* end = nullptr;
          const unsigned code = static_cast<unsigned>(std::strtoul(hex.c_str(), &end, 16));
          if (end != hex.c_str() + 4) fail("bad \\u escape");
          pos_ += 4;
          append_utf8(out, code);
          break;
        }
        default:
          fail("unknown escape");
      }
    }
  }
  JsonValue parse_value() {
    skip_blanks();
    JsonValue value;
    if (pos_ >= text_.size()) fail("unexpected end");
    const char c = text_[pos_];
    if (c == '{') {
      ++pos_;
      value.kind = JsonValue::Kind::object;
      if (take('}')) return value;
      do {
        skip_blanks();
        const std::string key = parse_string();
        expect(':');
        value.members[key] = parse_value();
      } while (take(','));
      expect('}');
    } else if (c == '[') {
      ++pos_;
      value.kind = JsonValue::Kind::array;
      if (take(']')) return value;
      do {
        value.items.push_back(parse_value());
      } while (take(','));
      expect(']');
    } else if (c == '"') {
      value.kind = JsonValue::Kind::string;
      value.text = parse_string();
    } else if (take_word("true")) {
      value.kind = JsonValue::Kind::boolean;
      value.boolean = true;
    } else if (take_word("false")) {
      value.kind = JsonValue::Kind::boolean;
    } else if (take_word("null")) {
      value.kind = JsonValue::Kind::null;
    } else {
      const char* begin = text_.c_str() + pos_;
      char* end = nullptr;
      value.number = std::strtod(begin, &end);
      if (end == begin || *begin == '+' || *begin == '.') fail("bad value");
      pos_ += static_cast<size_t>(end - begin);
      value.kind = JsonValue::Kind::number;
    }
    return value;
  }

  const std::string& text_;
  size_t pos_ = 0;
};

inline JsonValue parse_json(const std::string& text) { return JsonReader(text).parse_document(); }

}  // namespace cli_test
