// An output file written under a temporary name next to its destination and
// renamed into place only once complete, so a failed run leaves nothing
// half-written at the destination.
#pragma once

#include <string>

namespace basic {

class PendingOutput {
 public:
  explicit PendingOutput(std::string final_path);
  ~PendingOutput();  // removes the temporary file unless committed
  PendingOutput(const PendingOutput&) = delete;
  PendingOutput& operator=(const PendingOutput&) = delete;

  const std::string& temp_path() const { return temp_path_; }
  const std::string& final_path() const { return final_path_; }
  // Renames the temporary file to the destination; throws std::runtime_error.
  void commit();

 private:
  std::string final_path_;
  std::string temp_path_;
  bool committed_ = false;
};

}  // namespace basic
