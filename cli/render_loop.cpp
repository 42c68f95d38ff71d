#include "cli/render_loop.h"

#include <algorithm>
#include <cstring>
#include <stdexcept>

namespace plugcore {

RenderLoop::RenderLoop(HostedPlugin& plugin, int block_size, ProcessMode mode)
    : plugin_(plugin), block_size_(block_size), mode_(mode) {
  if (block_size_ <= 0) {
    throw std::runtime_error("block size must be positive");
  }
  if (!plugin_.supports(mode_)) {
    throw std::runtime_error(mode_ == ProcessMode::replacing
                                 ? "plug-in cannot process replacing; try --mode adding"
                                 : "plug-in has no accumulating process entry");
  }
  const int inputs = std::max(plugin_.num_inputs(), 0);
  const int outputs = std::max(plugin_.num_outputs(), 0);
  output_channels_ = std::min(outputs, plugin_.context().connected_outputs);
  if (output_channels_ <= 0) {
    throw std::runtime_error("plug-in has no outputs");
  }
  // Even pins the plug-in does not declare get a buffer, so a plug-in that
  // peeks at pin 1 while declaring one input reads silence, not garbage.
  const size_t frames = static_cast<size_t>(block_size_);
  input_buffers_.assign(static_cast<size_t>(std::max(inputs, 2)), std::vector<float>(frames));
  output_buffers_.assign(static_cast<size_t>(std::max(outputs, 2)), std::vector<float>(frames));
  for (auto& buffer : input_buffers_) input_pointers_.push_back(buffer.data());
  for (auto& buffer : output_buffers_) output_pointers_.push_back(buffer.data());
}

void RenderLoop::process_block(const float* left, const float* right, size_t offset,
                               size_t count) {
  for (auto& buffer : input_buffers_) {
    std::fill(buffer.begin(), buffer.end(), 0.0f);
  }
  std::memcpy(input_buffers_[0].data(), left + offset, count * sizeof(float));
  if (right != nullptr && plugin_.context().connected_inputs > 1) {
    std::memcpy(input_buffers_[1].data(), right + offset, count * sizeof(float));
  }
  plugin_.process(input_pointers_.data(), output_pointers_.data(), static_cast<int>(count), mode_,
                  static_cast<int>(output_buffers_.size()));
}

void RenderLoop::run(const float* left, const float* right, size_t frames,
                     std::vector<std::vector<float>>& outputs,
                     const std::function<void(double)>& progress) {
  outputs.assign(static_cast<size_t>(output_channels_), std::vector<float>(frames));
  size_t done = 0;
  while (done < frames) {
    const size_t count = std::min(frames - done, static_cast<size_t>(block_size_));
    process_block(left, right, done, count);
    for (int channel = 0; channel < output_channels_; ++channel) {
      std::memcpy(outputs[static_cast<size_t>(channel)].data() + done,
                  output_buffers_[static_cast<size_t>(channel)].data(), count * sizeof(float));
    }
    done += count;
    if (progress) {
      progress(static_cast<double>(done) / static_cast<double>(frames));
    }
  }
}

void RenderLoop::run_discarding(const float* left, const float* right, size_t frames) {
  size_t done = 0;
  while (done < frames) {
    const size_t count = std::min(frames - done, static_cast<size_t>(block_size_));
    process_block(left, right, done, count);
    done += count;
  }
}

}  // namespace plugcore
