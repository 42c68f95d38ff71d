// What the validation battery found: one result per check, collected in
// order, and the options every check group reads.
#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <vector>

namespace plugcore {

enum class CheckStatus { pass, fail, skip };

struct CheckResult {
  std::string name;
  CheckStatus status = CheckStatus::fail;
  std::string reason;
};

struct ValidateOptions {
  std::string plugin_path;
  int strictness = 5;     // 1..10: how many trials each check makes
  uint32_t seed = 1;      // every random choice of the battery follows from it
  std::vector<std::string> only;  // group names to run; empty runs every group
};

class CheckRecorder {
 public:
  // Called with every result as it is recorded, so a long run shows progress.
  std::function<void(const CheckResult&)> on_result;

  void pass(const std::string& name, const std::string& reason);
  void fail(const std::string& name, const std::string& reason);
  void skip(const std::string& name, const std::string& reason);
  // Passes when failure is empty, else fails with it as the reason.
  void verdict(const std::string& name, const std::string& failure, const std::string& success);

  const std::vector<CheckResult>& results() const { return results_; }
  int count(CheckStatus status) const;

 private:
  std::vector<CheckResult> results_;
};

// Scales a trial count with the strictness: at 10 the full count, never below one.
int scaled_count(const ValidateOptions& options, int full_count);

}  // namespace plugcore
