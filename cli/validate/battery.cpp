#include "cli/validate/battery.h"

#include <algorithm>
#include <sstream>
#include <stdexcept>

#include "cli/json_text.h"
#include "cli/validate/check_groups.h"

namespace plugcore {
namespace {

using GroupFunction = void (*)(const ValidateOptions&, CheckRecorder&);

struct Group {
  const char* name;
  GroupFunction run;
};

const Group kGroups[] = {
    {"lifecycle", run_lifecycle_checks}, {"dispatcher", run_dispatcher_checks},
    {"audio", run_audio_checks},         {"threads", run_thread_checks},
    {"state", run_state_checks},         {"realtime", run_realtime_checks},
    {"editor", run_editor_checks},
};

const char* status_word(CheckStatus status) {
  switch (status) {
    case CheckStatus::pass: return "PASS";
    case CheckStatus::fail: return "FAIL";
    case CheckStatus::skip: return "SKIP";
  }
  return "FAIL";
}

}  // namespace

std::vector<std::string> battery_groups() {
  std::vector<std::string> names;
  for (const Group& group : kGroups) names.push_back(group.name);
  return names;
}

CheckRecorder run_battery(const ValidateOptions& options,
                          const std::function<void(const CheckResult&)>& on_result) {
  for (const std::string& wanted : options.only) {
    const auto names = battery_groups();
    if (std::find(names.begin(), names.end(), wanted) == names.end()) {
      throw std::runtime_error("no check group named " + wanted);
    }
  }
  CheckRecorder recorder;
  recorder.on_result = on_result;
  for (const Group& group : kGroups) {
    if (!options.only.empty() &&
        std::find(options.only.begin(), options.only.end(), group.name) == options.only.end()) {
      continue;
    }
    group.run(options, recorder);
  }
  return recorder;
}

std::string result_line(const CheckResult& result) {
  return std::string(status_word(result.status)) + " " + result.name + ": " + result.reason + "\n";
}

std::string battery_text(const CheckRecorder& recorder) {
  std::string text;
  for (const CheckResult& result : recorder.results()) text += result_line(result);
  return text + battery_summary(recorder);
}

std::string battery_summary(const CheckRecorder& recorder) {
  std::ostringstream out;
  const int skipped = recorder.count(CheckStatus::skip);
  if (skipped > 0) out << skipped << " skipped\n";
  out << recorder.count(CheckStatus::pass) << " passed, " << recorder.count(CheckStatus::fail)
      << " failed\n";
  return out.str();
}

std::string battery_json(const ValidateOptions& options, const CheckRecorder& recorder) {
  std::ostringstream out;
  out << "{\"plugin\":" << basic::json_quote(options.plugin_path)
      << ",\"strictness\":" << options.strictness << ",\"seed\":" << options.seed << ",\"checks\":[";
  bool first = true;
  for (const CheckResult& result : recorder.results()) {
    std::string status = status_word(result.status);
    std::transform(status.begin(), status.end(), status.begin(),
                   [](char c) { return static_cast<char>(c - 'A' + 'a'); });
    out << (first ? "" : ",") << "{\"name\":" << basic::json_quote(result.name)
        << ",\"status\":\"" << status << "\",\"reason\":" << basic::json_quote(result.reason) << "}";
    first = false;
  }
  out << "],\"passed\":" << recorder.count(CheckStatus::pass)
      << ",\"failed\":" << recorder.count(CheckStatus::fail)
      << ",\"skipped\":" << recorder.count(CheckStatus::skip) << "}\n";
  return out.str();
}

int battery_status(const CheckRecorder& recorder) {
  return recorder.count(CheckStatus::fail) > 0 ? 1 : 0;
}

}  // namespace plugcore
