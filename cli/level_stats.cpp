#include "cli/level_stats.h"

#include <cmath>
#include <cstdio>
#include <limits>

namespace basic {

LevelStats measure_levels(const std::vector<std::vector<float>>& channels) {
  LevelStats stats;
  double sum_squares = 0.0;
  size_t count = 0;
  for (const auto& channel : channels) {
    for (const float sample : channel) {
      const double value = sample;
      stats.peak = std::fmax(stats.peak, std::fabs(value));
      sum_squares += value * value;
    }
    count += channel.size();
  }
  stats.rms = count > 0 ? std::sqrt(sum_squares / static_cast<double>(count)) : 0.0;
  return stats;
}

double to_dbfs(double level) {
  if (!(level > 0.0)) {
    return -std::numeric_limits<double>::infinity();
  }
  return 20.0 * std::log10(level);
}

std::string format_dbfs(double level) {
  const double db = to_dbfs(level);
  if (std::isinf(db)) {
    return "-inf";
  }
  char text[32];
  std::snprintf(text, sizeof(text), "%.2f", db);
  return text;
}

}  // namespace basic
