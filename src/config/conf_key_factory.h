#pragma once

#include <memory>
#include <string>
#include <vector>

#include "config/conf_key.h"

namespace basic {

// Parse status codes of the configuration text.
enum ConfParseStatus : int {
  kConfTokensLeft = -1015,
  kConfTextExpected = -1016,
  kConfBadList = -1017,
  kConfNoValue = -1018,
  kConfBadMulti = -1019,
  kConfLexical = -1020,
  kConfBadElement = -1024,
};

// Reads the configuration text format back into a key tree. Each parse keeps
// its tokens and status in the factory, so a factory serves one thread; make
// one where it is needed rather than sharing one.
class ConfKeyFactory {
 public:
  struct Token {
    std::string text;
    bool quoted = false;
  };

  // A new key, or null. After a lexical error there is no key; after a later
  // error the partly filled key comes back together with a non-zero status,
  // and callers discard it.
  std::unique_ptr<ConfKeyInterface> create_from_string(const std::string& text);
  int get_status() const { return status_; }
  const std::vector<Token>& get_tokens() const { return tokens_; }

  // Lists nest at most this deep; deeper text is refused rather than
  // recursed into.
  static constexpr int kMaxDepth = 200;

 private:
  int tokenize(const std::string& text);
  bool is_mark(size_t pos, const char* mark) const;
  bool looks_like_key(size_t pos) const;
  int parse_key(size_t& pos, int depth, std::unique_ptr<ConfKeyInterface>& key);
  int parse_value(size_t& pos, int depth, std::unique_ptr<ConfKeyContentInterface>& value);

  std::vector<Token> tokens_;
  int status_ = 0;
};

}  // namespace basic
