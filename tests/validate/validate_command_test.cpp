// brakmorph validate as a program: the real counter in the executable, the
// closing line and exit status, JSON, and Brakmorph itself at full strictness.
#include <gtest/gtest.h>

#include <regex>
#include <sstream>
#include <string>

#include "cli/cli_test_support.h"
#include "cli/mini_json.h"

namespace {

#if defined(BRAKMORPH_TEST_FAULTY_PLUGIN)
const char* const kFaulty = BRAKMORPH_TEST_FAULTY_PLUGIN;
#else
const char* const kFaulty = "";
#endif

// Sanitizer runtimes replace the allocator, so those builds of the host carry
// no call counter and report the real-time checks as skipped.
#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
constexpr bool kHostCounts = false;
#else
constexpr bool kHostCounts = true;
#endif

class ValidateCommand : public ::testing::Test {
 protected:
  void SetUp() override {
    // One folder per test: ctest runs these in parallel processes.
    work_ = ::testing::TempDir() + "validate_command_" +
            ::testing::UnitTest::GetInstance()->current_test_info()->name();
    std::filesystem::create_directories(work_);
  }
  cli_test::RunResult run(const std::vector<std::string>& args, const std::string& fault = "") {
    std::vector<std::pair<std::string, std::string>> env;
    if (!fault.empty()) env.emplace_back("VALIDATE_FAKE_FAULT", fault);
    return cli_test::run_cli(args, work_, env);
  }
  std::string work_;
};

// The closing line, and the counts it gives against the lines above it.
void expect_consistent_summary(const std::string& out) {
  std::smatch match;
  ASSERT_TRUE(std::regex_search(out, match, std::regex("(\\d+) passed, (\\d+) failed\n$"))) << out;
  int passes = 0, fails = 0;
  for (size_t at = out.find("PASS "); at != std::string::npos; at = out.find("\nPASS ", at + 1)) ++passes;
  for (size_t at = out.find("FAIL "); at != std::string::npos; at = out.find("\nFAIL ", at + 1)) ++fails;
  EXPECT_EQ(std::stoi(match[1]), passes) << out;
  EXPECT_EQ(std::stoi(match[2]), fails) << out;
}

TEST_F(ValidateCommand, CountsAllocationsInTheAudioPath) {
  if (!kHostCounts) GTEST_SKIP() << "sanitized host: no call counter";
  const auto careful = run({"validate", "--plugin", kFaulty, "--only", "realtime"});
  EXPECT_EQ(careful.status, 0) << careful.out << careful.err;
  EXPECT_NE(careful.out.find("PASS realtime.process_replacing: 0 allocations"), std::string::npos)
      << careful.out;
  expect_consistent_summary(careful.out);

  const auto allocating = run({"validate", "--plugin", kFaulty, "--only", "realtime"}, "allocates");
  EXPECT_EQ(allocating.status, 1) << allocating.out;
  EXPECT_TRUE(std::regex_search(allocating.out,
                                std::regex("FAIL realtime.process_replacing: [1-9][0-9]* allocations")))
      << allocating.out;
  EXPECT_NE(allocating.out.find("0 passed, 2 failed"), std::string::npos) << allocating.out;
}

TEST_F(ValidateCommand, JsonCarriesEveryResult) {
  const auto result = run({"validate", "--plugin", kFaulty, "--only", "dispatcher,state",
                           "--strictness", "2", "--seed", "9", "--json"},
                          "accept_any_chunk");
  EXPECT_EQ(result.status, 1);
  const cli_test::JsonValue json = cli_test::parse_json(result.out);
  EXPECT_EQ(json["strictness"].number, 2);
  EXPECT_EQ(json["seed"].number, 9);
  int failed = 0;
  for (const auto& check : json["checks"].items) {
    if (check["status"].text == "fail") {
      ++failed;
      EXPECT_NE(check["name"].text.find("state.bad_"), std::string::npos) << check["name"].text;
    }
  }
  EXPECT_EQ(failed, 2);
  EXPECT_EQ(json["failed"].number, 2);
  EXPECT_EQ(json["passed"].number + json["failed"].number + json["skipped"].number,
            json["checks"].items.size());
}

TEST_F(ValidateCommand, BadOptionsAreUsageErrors) {
  EXPECT_EQ(run({"validate", "--strictness", "11"}).status, 2);
  EXPECT_EQ(run({"validate", "--bogus"}).status, 2);
  const auto missing = run({"validate", "--plugin", "/nonexistent.so"});
  EXPECT_EQ(missing.status, 1);
  EXPECT_NE(missing.err.find("cannot load"), std::string::npos) << missing.err;
}

TEST_F(ValidateCommand, BrakmorphPassesAtFullStrictness) {
  const auto result = run({"validate", "--plugin", BRAKMORPH_TEST_PLUGIN, "--strictness", "10"});
  EXPECT_EQ(result.status, 0) << result.out << result.err;
  EXPECT_EQ(result.out.find("FAIL"), std::string::npos) << result.out;
  expect_consistent_summary(result.out);
  if (kHostCounts) {
    // Nothing skips but the editor checks, and those only for want of a
    // display (or of an editor in a build without one).
    std::istringstream lines(result.out);
    for (std::string line; std::getline(lines, line);) {
      if (line.rfind("SKIP ", 0) != 0) continue;
      EXPECT_EQ(line.rfind("SKIP editor ", 0), 0u) << line;
      EXPECT_TRUE(line.find("DISPLAY is not set") != std::string::npos ||
                  line.find("declares no editor") != std::string::npos)
          << line;
    }
    EXPECT_NE(result.out.find("PASS realtime.process_replacing"), std::string::npos);
  } else {
    EXPECT_NE(result.out.find("SKIP realtime.process_replacing"), std::string::npos);
  }
}

}  // namespace
