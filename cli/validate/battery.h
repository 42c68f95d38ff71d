// The whole validation battery: which groups exist, running them, and the
// two ways of printing what they found.
#pragma once

#include <functional>
#include <string>
#include <vector>

#include "cli/validate/check_report.h"

namespace plugcore {

// Names of the check groups, in the order they run.
std::vector<std::string> battery_groups();

// Runs the groups options.only names (all when empty). Throws
// std::runtime_error for an unknown group name.
// Each result goes to on_result as soon as it is known.
CheckRecorder run_battery(const ValidateOptions& options,
                          const std::function<void(const CheckResult&)>& on_result = nullptr);

// "PASS name: reason"
std::string result_line(const CheckResult& result);
// The closing lines: skipped count when any, then "N passed, N failed".
std::string battery_summary(const CheckRecorder& recorder);

// One line per check ("PASS name: reason"), then "N passed, N failed".
std::string battery_text(const CheckRecorder& recorder);
std::string battery_json(const ValidateOptions& options, const CheckRecorder& recorder);

// The exit status: 0 when nothing failed, 1 otherwise.
int battery_status(const CheckRecorder& recorder);

}  // namespace plugcore
