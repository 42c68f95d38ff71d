// Text in JSON form: a quoted string literal with the characters JSON
// requires escaped.
#pragma once

#include <string>

namespace basic {

// Quotes text as a JSON string. Bytes below 0x20 become \uXXXX (or their short
// escapes); bytes that do not form valid UTF-8 become U+FFFD so the result is
// always valid JSON.
std::string json_quote(const std::string& text);

}  // namespace basic
