#include "cli/param_lookup.h"

#include <algorithm>
#include <cctype>
#include <cstdlib>
#include <stdexcept>

#include "cli/hosted_plugin.h"

namespace plugcore {
namespace {

std::string lower_trimmed(const std::string& text) {
  size_t begin = 0;
  size_t end = text.size();
  while (begin < end && std::isspace(static_cast<unsigned char>(text[begin]))) ++begin;
  while (end > begin && std::isspace(static_cast<unsigned char>(text[end - 1]))) --end;
  std::string result = text.substr(begin, end - begin);
  for (char& c : result) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
  return result;
}

std::string quoted_list(const std::vector<std::string>& names) {
  std::string list;
  for (const std::string& name : names) {
    if (!list.empty()) list += ", ";
    list += "\"" + name + "\"";
  }
  return list;
}

}  // namespace

std::vector<std::string> display_texts(HostedPlugin& plugin, int index) {
  // Sweeping the normalised range visits every choice of a stepped parameter;
  // the value in effect is put back afterwards.
  constexpr int kSteps = 200;
  constexpr size_t kMaxTexts = 64;
  const float original = plugin.get_norm(index);
  std::vector<std::string> texts;
  for (int step = 0; step <= kSteps && texts.size() < kMaxTexts; ++step) {
    plugin.set_norm(index, static_cast<float>(step) / kSteps);
    std::string text = plugin.param_display(index);
    if (std::find(texts.begin(), texts.end(), text) == texts.end()) {
      texts.push_back(std::move(text));
    }
  }
  plugin.set_norm(index, original);
  return texts;
}

size_t edit_distance(const std::string& a, const std::string& b) {
  const std::string x = lower_trimmed(a);
  const std::string y = lower_trimmed(b);
  std::vector<size_t> row(y.size() + 1);
  for (size_t j = 0; j <= y.size(); ++j) row[j] = j;
  for (size_t i = 1; i <= x.size(); ++i) {
    size_t diagonal = row[0];
    row[0] = i;
    for (size_t j = 1; j <= y.size(); ++j) {
      const size_t above = row[j];
      const size_t substitute = diagonal + (x[i - 1] == y[j - 1] ? 0 : 1);
      row[j] = std::min({above + 1, row[j - 1] + 1, substitute});
      diagonal = above;
    }
  }
  return row[y.size()];
}

int find_name(const std::vector<std::string>& names, const std::string& query) {
  const std::string wanted = lower_trimmed(query);
  for (size_t i = 0; i < names.size(); ++i) {
    if (lower_trimmed(names[i]) == wanted) {
      return static_cast<int>(i);
    }
  }
  return -1;
}

std::vector<std::string> closest_names(const std::vector<std::string>& names,
                                       const std::string& query, size_t count) {
  std::vector<std::pair<size_t, size_t>> ranked;  // distance, index
  for (size_t i = 0; i < names.size(); ++i) {
    ranked.emplace_back(edit_distance(names[i], query), i);
  }
  std::stable_sort(ranked.begin(), ranked.end(),
                   [](const auto& l, const auto& r) { return l.first < r.first; });
  std::vector<std::string> result;
  for (const auto& entry : ranked) {
    if (result.size() >= count) break;
    const std::string& name = names[entry.second];
    if (std::find(result.begin(), result.end(), name) == result.end()) {
      result.push_back(name);
    }
  }
  return result;
}

std::pair<std::string, std::string> split_assignment(const std::string& text,
                                                     const std::string& option) {
  const size_t equals = text.find('=');
  if (equals == std::string::npos || equals == 0) {
    throw std::runtime_error(option + " expects NAME=VALUE, got \"" + text + "\"");
  }
  return {text.substr(0, equals), text.substr(equals + 1)};
}

std::pair<int, float> parse_norm_assignment(const std::string& text) {
  const auto parts = split_assignment(text, "--norm");
  char* end = nullptr;
  const long index = std::strtol(parts.first.c_str(), &end, 10);
  if (end == parts.first.c_str() || *end != '\0' || index < 0) {
    throw std::runtime_error("--norm expects INDEX=VALUE with a parameter index, got \"" + text +
                             "\"");
  }
  const double value = std::strtod(parts.second.c_str(), &end);
  if (end == parts.second.c_str() || *end != '\0' || !(value >= 0.0 && value <= 1.0)) {
    throw std::runtime_error("--norm value must be a number in 0..1, got \"" + parts.second +
                             "\"");
  }
  return {static_cast<int>(index), static_cast<float>(value)};
}

void apply_settings(HostedPlugin& plugin, const ParamSettings& settings) {
  if (settings.program >= 0) {
    if (settings.program >= plugin.num_programs()) {
      throw std::runtime_error("program " + std::to_string(settings.program) +
                               " does not exist (the plug-in has " +
                               std::to_string(plugin.num_programs()) + " programs)");
    }
    plugin.set_program(settings.program);
  }
  const std::vector<std::string> names = plugin.param_names();
  for (const auto& setting : settings.texts) {
    const int index = find_name(names, setting.first);
    if (index < 0) {
      throw std::runtime_error("unknown parameter \"" + setting.first +
                               "\"; closest: " + quoted_list(closest_names(names, setting.first)));
    }
    if (!plugin.string_to_param(index, setting.second)) {
      const auto texts = display_texts(plugin, index);
      std::string reason = "parameter \"" + names[static_cast<size_t>(index)] +
                           "\" refused the text \"" + setting.second + "\"; closest: " +
                           quoted_list(closest_names(texts, setting.second));
      if (find_name(texts, setting.second) >= 0) {
        reason += " (this plug-in does not read back its own display texts; use --norm " +
                  std::to_string(index) + "=VALUE)";
      }
      throw std::runtime_error(reason);
    }
  }
  for (const auto& norm : settings.norms) {
    if (norm.first >= plugin.num_params()) {
      throw std::runtime_error("--norm index " + std::to_string(norm.first) +
                               " out of range (the plug-in has " +
                               std::to_string(plugin.num_params()) + " parameters)");
    }
    plugin.set_norm(norm.first, norm.second);
  }
}

}  // namespace plugcore
