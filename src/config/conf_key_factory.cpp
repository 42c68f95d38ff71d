#include "config/conf_key_factory.h"

#include <cstring>

namespace basic {

namespace {

bool is_separator(char c) { return c == ' ' || c == '\n' || c == '\t' || c == '\b' || c == '\v' || c == '\r'; }

// Splits one prepared line into tokens; a double quote starts a token that
// runs to the next double quote and is kept without its quotes.
void split_line(const std::string& line, std::vector<ConfKeyFactory::Token>& tokens) {
  size_t i = 0;
  while (i < line.size()) {
    if (is_separator(line[i])) {
      ++i;
    } else if (line[i] == '"') {
      const size_t end = line.find('"', i + 1);  // the lexer guarantees the closing quote
      tokens.push_back({line.substr(i + 1, end - i - 1), true});
      i = end + 1;
    } else {
      size_t end = i;
      while (end < line.size() && !is_separator(line[end]) && line[end] != '"') {
        ++end;
      }
      tokens.push_back({line.substr(i, end - i), false});
      i = end;
    }
  }
}

}  // namespace

int ConfKeyFactory::tokenize(const std::string& text) {
  int depth = 0;
  size_t start = 0;
  std::string line;
  while (start <= text.size()) {
    size_t end = text.find('\n', start);
    if (end == std::string::npos) {
      end = text.size();
    }
    line.clear();
    bool quoted = false;
    for (size_t i = start; i < end; ++i) {
      const char c = text[i];
      if (c == '"') {
        quoted = !quoted;
        line += c;
      } else if (quoted) {
        line += c;
      } else if (c == '/' && i + 1 < end && text[i + 1] == '/') {
        break;
      } else if (c == '=' || c == '{' || c == '}') {
        line += ' ';
        line += c;
        line += ' ';
        depth += c == '{' ? 1 : (c == '}' ? -1 : 0);
        if (depth < 0) {
          return kConfLexical;
        }
      } else {
        line += c;
      }
    }
    if (quoted) {
      return kConfLexical;
    }
    split_line(line, tokens_);
    start = end + 1;
  }
  return depth == 0 ? 0 : kConfLexical;
}

bool ConfKeyFactory::is_mark(size_t pos, const char* mark) const {
  return pos < tokens_.size() && !tokens_[pos].quoted && tokens_[pos].text == mark;
}

bool ConfKeyFactory::looks_like_key(size_t pos) const {
  return pos + 2 < tokens_.size() && is_mark(pos + 1, "=") && !is_mark(pos, "=") && !is_mark(pos + 2, "=");
}

int ConfKeyFactory::parse_key(size_t& pos, int depth, std::unique_ptr<ConfKeyInterface>& key) {
  const Token& name = tokens_[pos];
  if (depth > kMaxDepth || (!name.quoted && (name.text == "{" || name.text == "}")) ||
      name.text.find_first_of("/\\") != std::string::npos) {
    return kConfBadElement;
  }
  if (is_mark(pos + 2, "{") && is_mark(pos + 4, "=")) {
    auto multi = std::make_unique<ConfKeyMulti>(name.text);
    ConfKeyMulti* parent = multi.get();
    key = std::move(multi);
    pos += 3;
    while (!is_mark(pos, "}")) {
      if (!looks_like_key(pos)) {
        return kConfBadMulti;
      }
      std::unique_ptr<ConfKeyInterface> child;
      const int status = parse_key(pos, depth + 1, child);
      if (child) {
        parent->adopt_key(std::move(child));
      }
      if (status != 0) {
        return status;
      }
    }
    ++pos;
    return 0;
  }
  auto data = std::make_unique<ConfKeyData>(name.text);
  ConfKeyData* target = data.get();
  key = std::move(data);
  pos += 2;
  if (pos >= tokens_.size()) {
    return kConfNoValue;
  }
  std::unique_ptr<ConfKeyContentInterface> value;
  const int status = parse_value(pos, depth + 1, value);
  target->adopt_content(std::move(value));
  return status;
}

int ConfKeyFactory::parse_value(size_t& pos, int depth, std::unique_ptr<ConfKeyContentInterface>& value) {
  if (pos >= tokens_.size()) {
    return kConfTextExpected;
  }
  if (depth > kMaxDepth) {
    return kConfBadElement;
  }
  if (is_mark(pos, "{")) {
    auto list = std::make_unique<ConfKeyContentMulti>();
    ConfKeyContentMulti* target = list.get();
    value = std::move(list);
    ++pos;
    while (!is_mark(pos, "}")) {
      if (pos >= tokens_.size() || is_mark(pos, "=")) {
        return kConfBadList;
      }
      std::unique_ptr<ConfKeyContentInterface> item;
      const int status = parse_value(pos, depth + 1, item);
      if (item) {
        target->adopt_content(std::move(item));
      }
      if (status != 0) {
        return status;
      }
    }
    ++pos;
    return 0;
  }
  if (is_mark(pos, "}") || is_mark(pos, "=")) {
    return kConfBadElement;
  }
  value = std::make_unique<ConfKeyContentString>(tokens_[pos].text);
  ++pos;
  return 0;
}

std::unique_ptr<ConfKeyInterface> ConfKeyFactory::create_from_string(const std::string& text) {
  tokens_.clear();
  status_ = tokenize(text);
  if (status_ != 0) {
    tokens_.clear();
    return nullptr;
  }
  if (!looks_like_key(0)) {
    status_ = kConfTokensLeft;
    return nullptr;
  }
  size_t pos = 0;
  std::unique_ptr<ConfKeyInterface> key;
  status_ = parse_key(pos, 0, key);
  if (status_ == 0 && pos != tokens_.size()) {
    status_ = kConfTokensLeft;
  }
  return key;
}

}  // namespace basic
