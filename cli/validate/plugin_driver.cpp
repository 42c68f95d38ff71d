#include "cli/validate/plugin_driver.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <limits>
#include <stdexcept>

namespace plugcore {

PluginDriver::PluginDriver(const std::string& path, double sample_rate, int max_block,
                           int connected_inputs, int connected_outputs)
    : plugin_(std::make_unique<HostedPlugin>(path, sample_rate, max_block, connected_inputs,
                                             connected_outputs)) {
  allocate(max_block);
  plugin_->resume();
}

void PluginDriver::allocate(int max_block) {
  max_block_ = max_block;
  const size_t frames = static_cast<size_t>(max_block);
  const size_t inputs = static_cast<size_t>(std::max(plugin_->num_inputs(), 2));
  const size_t outputs = static_cast<size_t>(std::max(plugin_->num_outputs(), 2));
  inputs_.assign(inputs, std::vector<float>(frames, 0.0f));
  outputs_.assign(outputs, std::vector<float>(frames, 0.0f));
  input_pointers_.clear();
  output_pointers_.clear();
  for (auto& buffer : inputs_) input_pointers_.push_back(buffer.data());
  for (auto& buffer : outputs_) output_pointers_.push_back(buffer.data());
}

int PluginDriver::connected_outputs() const {
  return std::min(plugin_->context().connected_outputs, plugin_->num_outputs());
}

void PluginDriver::reconfigure(double sample_rate, int max_block, int connected_inputs,
                               int connected_outputs) {
  plugin_->suspend();
  HostCallbackContext& context = plugin_->context();
  context.sample_rate = sample_rate;
  context.block_size = max_block;
  context.connected_inputs = connected_inputs;
  context.connected_outputs = connected_outputs;
  plugin_->dispatch(effSetSampleRate, 0, 0, nullptr, static_cast<float>(sample_rate));
  plugin_->dispatch(effSetBlockSize, 0, max_block);
  if (max_block != max_block_) allocate(max_block);
  plugin_->resume();
}

void PluginDriver::restart() {
  plugin_->suspend();
  plugin_->resume();
}

void PluginDriver::process(int frames, ProcessMode mode) {
  if (frames < 0 || frames > max_block_) {
    throw std::logic_error("block larger than announced");
  }
  const int connected_inputs = plugin_->context().connected_inputs;
  for (size_t channel = static_cast<size_t>(std::max(connected_inputs, 0)); channel < inputs_.size();
       ++channel) {
    std::fill(inputs_[channel].begin(), inputs_[channel].begin() + frames, 0.0f);
  }
  AEffect* effect = plugin_->effect();
  if (mode == ProcessMode::replacing) {
    for (auto& buffer : outputs_) {
      std::fill(buffer.begin(), buffer.begin() + frames, std::numeric_limits<float>::quiet_NaN());
    }
    effect->processReplacing(effect, input_pointers_.data(), output_pointers_.data(), frames);
  } else {
    effect->process(effect, input_pointers_.data(), output_pointers_.data(), frames);
  }
  plugin_->context().sample_pos += frames;
}

std::string PluginDriver::check_outputs(int frames, float bound) const {
  for (int channel = 0; channel < connected_outputs(); ++channel) {
    const float* samples = output(channel);
    for (int n = 0; n < frames; ++n) {
      if (!std::isfinite(samples[n])) {
        return "output " + std::to_string(channel) + " sample " + std::to_string(n) + " of " +
               std::to_string(frames) + " is not finite (" + std::to_string(samples[n]) + ")";
      }
      if (std::fabs(samples[n]) > bound) {
        return "output " + std::to_string(channel) + " sample " + std::to_string(n) + " is " +
               std::to_string(samples[n]) + ", above the bound " + std::to_string(bound);
      }
    }
  }
  return "";
}

void PluginDriver::append_outputs(int frames, std::vector<std::vector<float>>& collected) const {
  const size_t channels = static_cast<size_t>(std::max(connected_outputs(), 0));
  if (collected.size() < channels) collected.resize(channels);
  for (size_t channel = 0; channel < channels; ++channel) {
    const float* samples = output(static_cast<int>(channel));
    collected[channel].insert(collected[channel].end(), samples, samples + frames);
  }
}

}  // namespace plugcore

namespace plugcore {

std::vector<std::vector<float>> render_blocks(PluginDriver& driver,
                                              const std::vector<std::vector<float>>& input,
                                              int block, ProcessMode mode) {
  std::vector<std::vector<float>> collected;
  const size_t frames = input.empty() ? 0 : input[0].size();
  size_t done = 0;
  while (done < frames) {
    const int count = static_cast<int>(std::min(frames - done, static_cast<size_t>(block)));
    for (size_t channel = 0; channel < input.size() && channel < 2; ++channel) {
      std::memcpy(driver.input(static_cast<int>(channel)), input[channel].data() + done,
                  sizeof(float) * static_cast<size_t>(count));
    }
    if (mode == ProcessMode::adding) {
      for (int channel = 0; channel < driver.output_count(); ++channel) {
        std::memset(driver.output_for_writing(channel), 0, sizeof(float) * static_cast<size_t>(count));
      }
    }
    driver.process(count, mode);
    driver.append_outputs(count, collected);
    done += static_cast<size_t>(count);
  }
  return collected;
}

}  // namespace plugcore
