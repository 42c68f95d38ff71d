// Block-by-block processing of a whole signal through one instance: fills the
// plug-in's input pins from at most two source channels and collects the
// outputs the host uses.
#pragma once

#include <cstddef>
#include <functional>
#include <vector>

#include "cli/hosted_plugin.h"

namespace plugcore {

class RenderLoop {
 public:
  // The instance's context says how many input and output pins are connected;
  // the first min(connected outputs, outputs) outputs are collected.
  RenderLoop(HostedPlugin& plugin, int block_size, ProcessMode mode);

  int output_channels() const { return output_channels_; }

  // Processes frames frames: left feeds pin 0 and right pin 1 (null right, or
  // an unconnected pin 1, gets silence; further pins get silence). Output
  // channels are resized to frames. progress, when set, gets the fraction done
  // after every block.
  void run(const float* left, const float* right, size_t frames,
           std::vector<std::vector<float>>& outputs,
           const std::function<void(double)>& progress = nullptr);

  // The same processing without collecting the outputs: what the benchmark times.
  void run_discarding(const float* left, const float* right, size_t frames);

 private:
  void process_block(const float* left, const float* right, size_t offset, size_t count);

  HostedPlugin& plugin_;
  int block_size_;
  ProcessMode mode_;
  int output_channels_;
  std::vector<std::vector<float>> input_buffers_;
  std::vector<std::vector<float>> output_buffers_;
  std::vector<float*> input_pointers_;
  std::vector<float*> output_pointers_;
};

}  // namespace plugcore
