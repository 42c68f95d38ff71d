#include "cli/command_args.h"

#include <cerrno>
#include <cmath>
#include <cstdlib>

namespace basic {

ArgReader::ArgReader(std::vector<std::string> args) : args_(std::move(args)) {}

std::string ArgReader::next() {
  if (has_inline_) {
    throw UsageError("option does not take a value: " + args_[position_ - 1]);
  }
  std::string arg = args_[position_++];
  const size_t equals = arg.find('=');
  if (arg.rfind("--", 0) == 0 && equals != std::string::npos) {
    has_inline_ = true;
    inline_value_ = arg.substr(equals + 1);
    arg.resize(equals);
  }
  return arg;
}

std::string ArgReader::value(const std::string& option) {
  if (has_inline_) {
    has_inline_ = false;
    return inline_value_;
  }
  if (done()) {
    throw UsageError(option + " needs a value");
  }
  return args_[position_++];
}

int parse_int(const std::string& text, const std::string& option, long low, long high) {
  char* end = nullptr;
  errno = 0;
  const long value = std::strtol(text.c_str(), &end, 10);
  if (text.empty() || *end != '\0' || errno != 0 || value < low || value > high) {
    throw UsageError(option + " expects a whole number in " + std::to_string(low) + ".." +
                     std::to_string(high) + ", got \"" + text + "\"");
  }
  return static_cast<int>(value);
}

double parse_double(const std::string& text, const std::string& option, double low,
                    double high) {
  char* end = nullptr;
  const double value = std::strtod(text.c_str(), &end);
  if (text.empty() || *end != '\0' || !std::isfinite(value) || value < low || value > high) {
    throw UsageError(option + " expects a number in " + std::to_string(low) + ".." +
                     std::to_string(high) + ", got \"" + text + "\"");
  }
  return value;
}

}  // namespace basic
