#include "cli/pending_output.h"

#include <cstdio>
#include <stdexcept>

namespace basic {

PendingOutput::PendingOutput(std::string final_path)
    : final_path_(std::move(final_path)), temp_path_(final_path_ + ".partial") {}

PendingOutput::~PendingOutput() {
  if (!committed_) {
    std::remove(temp_path_.c_str());
  }
}

void PendingOutput::commit() {
  if (std::rename(temp_path_.c_str(), final_path_.c_str()) != 0) {
    throw std::runtime_error("cannot rename " + temp_path_ + " to " + final_path_);
  }
  committed_ = true;
}

}  // namespace basic
