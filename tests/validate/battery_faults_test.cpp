// The battery against a plug-in that commits one fault at a time: each fault
// must turn exactly the check meant for it into a FAIL, and the careful
// plug-in must pass everything, so no check passes or fails regardless.
#include <gtest/gtest.h>

#include <cstdlib>
#include <string>
#include <vector>

#include "cli/validate/battery.h"

namespace {

using plugcore::CheckRecorder;
using plugcore::CheckResult;
using plugcore::CheckStatus;
using plugcore::ValidateOptions;

#if defined(BRAKMORPH_TEST_FAULTY_PLUGIN)
const char* const kFaulty = BRAKMORPH_TEST_FAULTY_PLUGIN;
#else
const char* const kFaulty = "";
#endif

class ScopedFault {
 public:
  explicit ScopedFault(const std::string& fault) {
    if (fault.empty()) {
      unsetenv("VALIDATE_FAKE_FAULT");
    } else {
      setenv("VALIDATE_FAKE_FAULT", fault.c_str(), 1);
    }
  }
  ~ScopedFault() { unsetenv("VALIDATE_FAKE_FAULT"); }
};

CheckRecorder run_groups(const std::vector<std::string>& groups, const std::string& fault,
                         int strictness = 3) {
  ScopedFault scoped(fault);
  ValidateOptions options;
  options.plugin_path = kFaulty;
  options.strictness = strictness;
  options.seed = 5;
  options.only = groups;
  return plugcore::run_battery(options);
}

const CheckResult* find(const CheckRecorder& recorder, const std::string& name) {
  for (const CheckResult& result : recorder.results()) {
    if (result.name == name) return &result;
  }
  return nullptr;
}

TEST(ValidateBattery, CarefulPluginPassesEveryCheck) {
  ASSERT_STRNE(kFaulty, "");
  const CheckRecorder recorder =
      run_groups({"lifecycle", "dispatcher", "audio", "threads", "state"}, "");
  EXPECT_GE(recorder.results().size(), 19u);
  for (const CheckResult& result : recorder.results()) {
    EXPECT_EQ(result.status, CheckStatus::pass) << result.name << ": " << result.reason;
  }
  EXPECT_EQ(plugcore::battery_status(recorder), 0);
}

struct FaultCase {
  const char* fault;
  const char* group;
  const char* check;
  const char* reason_part;  // the reason must say what went wrong
};

const FaultCase kFaultCases[] = {
    {"accept_versionless", "lifecycle", "lifecycle.host_version_0", "answers 0"},
    {"shared_state", "lifecycle", "lifecycle.parallel", "differs"},
    {"unterminated_text", "dispatcher", "dispatcher.texts", "not terminated"},
    {"overrun_index", "dispatcher", "dispatcher.sweep", "beyond the capacity"},
    {"loud", "audio", "audio.rate_44100", "above the bound"},
    {"sticky_nan", "audio", "audio.non_finite_recovery", "not finite"},
    {"adding_replaces", "audio", "audio.adding_adds", "adding gave"},
    {"param_out_of_range", "threads", "threads.automation", "getParameter"},
    {"accept_any_chunk", "state", "state.bad_bank_chunks", "accepted"},
    {"accept_any_chunk", "state", "state.bad_program_chunks", "accepted"},
    {"lossy_chunk", "state", "state.bank_chunk", "sounds different"},
    {"sticky_program", "state", "state.program_switch", "unlike a fresh selection"},
};

class FaultIsCaught : public ::testing::TestWithParam<FaultCase> {};

TEST_P(FaultIsCaught, ByItsCheck) {
  const FaultCase& fault = GetParam();
  const CheckRecorder recorder = run_groups({fault.group}, fault.fault);
  const CheckResult* result = find(recorder, fault.check);
  ASSERT_NE(result, nullptr) << fault.check << " did not run";
  EXPECT_EQ(result->status, CheckStatus::fail) << result->reason;
  EXPECT_NE(result->reason.find(fault.reason_part), std::string::npos) << result->reason;
  EXPECT_EQ(plugcore::battery_status(recorder), 1);
}

INSTANTIATE_TEST_SUITE_P(EachFault, FaultIsCaught, ::testing::ValuesIn(kFaultCases),
                         [](const ::testing::TestParamInfo<FaultCase>& info) {
                           return std::string(info.param.fault) + "_" +
                                  std::to_string(info.index);
                         });

TEST(ValidateBattery, FaultStaysInItsCheck) {
  // A loud plug-in breaks the level checks but not, say, the text checks.
  const CheckRecorder recorder = run_groups({"dispatcher", "audio"}, "loud");
  EXPECT_EQ(find(recorder, "dispatcher.texts")->status, CheckStatus::pass);
  EXPECT_EQ(find(recorder, "audio.adding_adds")->status, CheckStatus::pass);
  EXPECT_GE(recorder.count(CheckStatus::fail), 1);
}

TEST(ValidateBattery, WithoutCounterRealtimeChecksSkipRatherThanPass) {
  // This test binary carries no allocation counter: the checks must not claim a pass.
  const CheckRecorder recorder = run_groups({"realtime"}, "allocates");
  ASSERT_EQ(recorder.results().size(), 2u);
  for (const CheckResult& result : recorder.results()) {
    EXPECT_EQ(result.status, CheckStatus::skip) << result.name;
    EXPECT_NE(result.reason.find("counter"), std::string::npos) << result.reason;
  }
}

TEST(ValidateBattery, UnknownGroupAndMissingPluginAreErrorsNotPasses) {
  ValidateOptions options;
  options.plugin_path = kFaulty;
  options.only = {"no_such_group"};
  EXPECT_THROW(plugcore::run_battery(options), std::runtime_error);

  options.only = {"lifecycle"};
  options.plugin_path = "/nonexistent/plugin.so";
  const CheckRecorder recorder = plugcore::run_battery(options);
  EXPECT_EQ(recorder.count(CheckStatus::pass), 0);
  EXPECT_EQ(recorder.count(CheckStatus::fail), 3);
}

TEST(ValidateBattery, SummaryCountsMatchTheLines) {
  CheckRecorder recorder;
  recorder.pass("a.one", "fine");
  recorder.fail("a.two", "broken \"quoted\"");
  recorder.skip("a.three", "cannot tell");
  recorder.pass("a.four", "fine");
  const std::string text = plugcore::battery_text(recorder);
  EXPECT_EQ(text,
            "PASS a.one: fine\nFAIL a.two: broken \"quoted\"\nSKIP a.three: cannot tell\n"
            "PASS a.four: fine\n1 skipped\n2 passed, 1 failed\n");
  EXPECT_EQ(plugcore::battery_status(recorder), 1);
}

}  // namespace
