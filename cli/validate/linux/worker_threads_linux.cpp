#include <thread>

#include "cli/validate/worker_threads.h"

namespace sys {

void run_in_parallel(const std::vector<std::function<void()>>& jobs) {
  std::vector<std::thread> threads;
  threads.reserve(jobs.size());
  for (const auto& job : jobs) threads.emplace_back(job);
  for (auto& thread : threads) thread.join();
}

}  // namespace sys
