#include "cli/progress_bar.h"

#include <cstdio>

namespace basic {

namespace {
constexpr double kShowAfterSeconds = 1.0;
constexpr double kRedrawSeconds = 0.1;
constexpr int kWidth = 40;
}  // namespace

ProgressBar::ProgressBar(std::string label, bool enabled)
    : label_(std::move(label)),
      enabled_(enabled),
      start_(std::chrono::steady_clock::now()),
      last_draw_(start_) {}

ProgressBar::~ProgressBar() {
  if (drawn_) {
    std::fprintf(stderr, "\r%*s\r", kWidth + static_cast<int>(label_.size()) + 10, "");
    std::fflush(stderr);
  }
}

void ProgressBar::update(double fraction) {
  if (!enabled_) return;
  const auto now = std::chrono::steady_clock::now();
  const double elapsed = std::chrono::duration<double>(now - start_).count();
  const double since_draw = std::chrono::duration<double>(now - last_draw_).count();
  if (elapsed < kShowAfterSeconds || (drawn_ && since_draw < kRedrawSeconds && fraction < 1.0)) {
    return;
  }
  const int filled = static_cast<int>(fraction * kWidth + 0.5);
  std::string bar(static_cast<size_t>(filled), '#');
  bar.resize(kWidth, '.');
  std::fprintf(stderr, "\r%s [%s] %3d%%", label_.c_str(), bar.c_str(),
               static_cast<int>(fraction * 100.0 + 0.5));
  std::fflush(stderr);
  drawn_ = true;
  last_draw_ = now;
}

}  // namespace basic
