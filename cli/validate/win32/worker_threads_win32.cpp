// The toolchain's thread model has no std::thread; Win32 threads do the same.
#include <windows.h>

#include "cli/validate/worker_threads.h"

namespace sys {
namespace {

DWORD WINAPI run_job(LPVOID job) {
  (*static_cast<const std::function<void()>*>(job))();
  return 0;
}

}  // namespace

void run_in_parallel(const std::vector<std::function<void()>>& jobs) {
  std::vector<HANDLE> threads;
  for (const auto& job : jobs) {
    HANDLE thread = CreateThread(nullptr, 0, run_job,
                                 const_cast<std::function<void()>*>(&job), 0, nullptr);
    if (thread == nullptr) {
      job();  // no thread to spare: run it here rather than lose it
    } else {
      threads.push_back(thread);
    }
  }
  for (HANDLE thread : threads) {
    WaitForSingleObject(thread, INFINITE);
    CloseHandle(thread);
  }
}

}  // namespace sys
