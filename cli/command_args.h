// Reading a command's options off the command line, one at a time.
#pragma once

#include <stdexcept>
#include <string>
#include <vector>

namespace basic {

// A mistake on the command line; the program answers it with exit status 2.
class UsageError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

class ArgReader {
 public:
  explicit ArgReader(std::vector<std::string> args);

  bool done() const { return position_ >= args_.size(); }
  // The next argument; "--name=value" is taken apart into "--name" and a
  // pending value.
  std::string next();
  // The value of the option just read by next(). Throws UsageError when none follows.
  std::string value(const std::string& option);
  bool has_inline_value() const { return has_inline_; }

 private:
  std::vector<std::string> args_;
  size_t position_ = 0;
  bool has_inline_ = false;
  std::string inline_value_;
};

int parse_int(const std::string& text, const std::string& option, long low, long high);
double parse_double(const std::string& text, const std::string& option, double low, double high);

}  // namespace basic
