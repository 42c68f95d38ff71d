// One configuration the benchmark measures: which plug-in, its settings and
// the block size, parsed from "NAME:key=value,key=value".
#pragma once

#include <string>

#include "cli/hosted_plugin.h"
#include "cli/param_lookup.h"

namespace plugcore {

struct BenchCase {
  std::string name;
  std::string plugin_path;
  ParamSettings settings;
  int block = 512;
  ProcessMode mode = ProcessMode::replacing;
};

// Keys: plugin=PATH, program=N, set=NAME=TEXT, norm=INDEX=VALUE, block=N,
// mode=replacing|adding; set and norm may repeat. Keys not given come from
// defaults. Throws std::runtime_error on a malformed description.
BenchCase parse_bench_case(const std::string& text, const BenchCase& defaults);

}  // namespace plugcore
