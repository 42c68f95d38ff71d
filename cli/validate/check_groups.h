// The groups of checks of the battery, one file each. Every group records one
// result per check and never throws: a failure inside becomes a FAIL line.
#pragma once

#include "cli/validate/check_report.h"

namespace plugcore {

void run_lifecycle_checks(const ValidateOptions& options, CheckRecorder& recorder);
void run_dispatcher_checks(const ValidateOptions& options, CheckRecorder& recorder);
void run_audio_checks(const ValidateOptions& options, CheckRecorder& recorder);
void run_thread_checks(const ValidateOptions& options, CheckRecorder& recorder);
void run_state_checks(const ValidateOptions& options, CheckRecorder& recorder);
void run_realtime_checks(const ValidateOptions& options, CheckRecorder& recorder);
void run_editor_checks(const ValidateOptions& options, CheckRecorder& recorder);

// Runs check, turning an exception into a FAIL line for name.
template <typename Check>
void guarded(CheckRecorder& recorder, const char* name, Check check) {
  try {
    check();
  } catch (const std::exception& error) {
    recorder.fail(name, error.what());
  }
}

}  // namespace plugcore
