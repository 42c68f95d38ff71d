// Finding parameters by the names a user types, and applying the command
// line's program, text and normalised settings to an instance.
#pragma once

#include <string>
#include <utility>
#include <vector>

namespace plugcore {

class HostedPlugin;

// Index of the name equal to query ignoring case and surrounding blanks, or -1.
int find_name(const std::vector<std::string>& names, const std::string& query);

// Up to count names nearest to query (edit distance ignoring case), nearest first.
std::vector<std::string> closest_names(const std::vector<std::string>& names,
                                       const std::string& query, size_t count = 3);

// Case-insensitive edit distance (insert, delete, substitute each cost 1).
size_t edit_distance(const std::string& a, const std::string& b);

// The distinct display texts a parameter shows across its normalised range.
std::vector<std::string> display_texts(HostedPlugin& plugin, int index);

// "LEFT=RIGHT" split at the first '='; throws std::runtime_error naming the
// option when there is no '=' or the left side is empty.
std::pair<std::string, std::string> split_assignment(const std::string& text,
                                                     const std::string& option);

struct ParamSettings {
  int program = -1;                                         // -1: leave the program alone
  std::vector<std::pair<std::string, std::string>> texts;   // name, display text
  std::vector<std::pair<int, float>> norms;                 // index, normalised value
};

// Parses "INDEX=VALUE" for --norm; VALUE must lie in 0..1.
std::pair<int, float> parse_norm_assignment(const std::string& text);

// Program first, then the texts, then the normalised values. Throws
// std::runtime_error naming the closest candidates for an unknown name or a
// text the plug-in refuses.
void apply_settings(HostedPlugin& plugin, const ParamSettings& settings);

}  // namespace plugcore
