// One instance under test with the buffers a host keeps for it: inputs and
// outputs for every declared pin (at least two), sized for the largest block,
// and the calls a host makes when it changes rate, block size or pins.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "cli/hosted_plugin.h"

namespace plugcore {

class PluginDriver {
 public:
  // Loads, opens, sets rate and block size and resumes.
  PluginDriver(const std::string& path, double sample_rate, int max_block,
               int connected_inputs = 2, int connected_outputs = 2);

  HostedPlugin& plugin() { return *plugin_; }
  int max_block() const { return max_block_; }
  int input_count() const { return static_cast<int>(inputs_.size()); }
  int output_count() const { return static_cast<int>(outputs_.size()); }
  int connected_outputs() const;

  // Suspends, applies the new rate, maximum block and pin connections, resumes.
  void reconfigure(double sample_rate, int max_block, int connected_inputs, int connected_outputs);
  // effMainsChanged off and on: the reset a host does when playback restarts.
  void restart();

  float* input(int channel) { return inputs_[static_cast<size_t>(channel)].data(); }
  const float* output(int channel) const { return outputs_[static_cast<size_t>(channel)].data(); }
  float* output_for_writing(int channel) { return outputs_[static_cast<size_t>(channel)].data(); }

  // Zeroes the inputs beyond the connected ones, then one process call.
  // Replacing mode first fills the outputs with NaN, so a sample the plug-in
  // does not write shows; adding mode leaves them as they are.
  void process(int frames, ProcessMode mode);

  // Every connected output of the last block finite and within bound;
  // empty when so, else what was wrong and where.
  std::string check_outputs(int frames, float bound) const;

  // Copies the connected outputs of the last block into collected.
  void append_outputs(int frames, std::vector<std::vector<float>>& collected) const;

  // Sets every parameter to a random value; extremes included half the time.
  template <typename Random>
  void randomize_parameters(Random& random);

 private:
  void allocate(int max_block);

  std::unique_ptr<HostedPlugin> plugin_;
  int max_block_ = 0;
  std::vector<std::vector<float>> inputs_;
  std::vector<std::vector<float>> outputs_;
  std::vector<float*> input_pointers_;
  std::vector<float*> output_pointers_;
};

template <typename Random>
void PluginDriver::randomize_parameters(Random& random) {
  for (int index = 0; index < plugin_->num_params(); ++index) {
    const uint32_t draw = static_cast<uint32_t>(random());
    float value = static_cast<float>(draw % 1000001u) / 1000000.0f;
    if (draw % 7u == 0u) value = 0.0f;
    if (draw % 7u == 1u) value = 1.0f;
    plugin_->set_norm(index, value);
  }
}

}  // namespace plugcore

namespace plugcore {

// Processes input (two channels, any length) in blocks of block frames and
// returns the connected outputs.
std::vector<std::vector<float>> render_blocks(PluginDriver& driver,
                                              const std::vector<std::vector<float>>& input,
                                              int block, ProcessMode mode);

}  // namespace plugcore
