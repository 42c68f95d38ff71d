#include "cli/validate/check_report.h"

#include <algorithm>

namespace plugcore {

void CheckRecorder::pass(const std::string& name, const std::string& reason) {
  results_.push_back(CheckResult{name, CheckStatus::pass, reason});
  if (on_result) on_result(results_.back());
}

void CheckRecorder::fail(const std::string& name, const std::string& reason) {
  results_.push_back(CheckResult{name, CheckStatus::fail, reason});
  if (on_result) on_result(results_.back());
}

void CheckRecorder::skip(const std::string& name, const std::string& reason) {
  results_.push_back(CheckResult{name, CheckStatus::skip, reason});
  if (on_result) on_result(results_.back());
}

void CheckRecorder::verdict(const std::string& name, const std::string& failure,
                            const std::string& success) {
  if (failure.empty()) {
    pass(name, success);
  } else {
    fail(name, failure);
  }
}

int CheckRecorder::count(CheckStatus status) const {
  return static_cast<int>(std::count_if(results_.begin(), results_.end(),
                                        [status](const CheckResult& r) { return r.status == status; }));
}

int scaled_count(const ValidateOptions& options, int full_count) {
  const int strictness = std::min(std::max(options.strictness, 1), 10);
  return std::max(1, full_count * strictness / 10);
}

}  // namespace plugcore
