// Peak and RMS levels of rendered audio, in dBFS (full scale = 1.0).
#pragma once

#include <string>
#include <vector>

namespace basic {

struct LevelStats {
  double peak = 0.0;  // largest absolute sample
  double rms = 0.0;   // over every sample of every channel
};

LevelStats measure_levels(const std::vector<std::vector<float>>& channels);

// 20 log10(level); -infinity for silence.
double to_dbfs(double level);

// "-6.02" with two decimals, or "-inf".
std::string format_dbfs(double level);

}  // namespace basic
