#pragma once

#include <cstdint>
#include <string>

namespace guikit {

class TextInputRequest;

// A one-line text editor over the window. When it ends it sends the requesting
// handler a TextInputFinished with the text and whether it was accepted.
class TextLineEditorInterface {
 public:
  virtual ~TextLineEditorInterface() = default;
  virtual int32_t start(const TextInputRequest& request) = 0;
  virtual int32_t stop(bool accept) = 0;
  virtual bool is_active() const = 0;
};

}  // namespace guikit
