// State as hosts keep it: chunks (bank and program) taken from one instance
// and given to a fresh one must sound bit for bit the same; random and cut
// chunks must be refused and leave the state alone; switching programs
// while processing must land exactly on the program.
#include <algorithm>
#include <cstring>
#include <string>
#include <vector>

#include "cli/validate/check_groups.h"
#include "cli/validate/plugin_driver.h"
#include "cli/validate/test_signal.h"

namespace plugcore {
namespace {

constexpr double kRate = 44100.0;
constexpr int kBlock = 333;
constexpr int kFrames = 8192;

std::vector<uint8_t> take_chunk(HostedPlugin& plugin, bool program_only) {
  void* address = nullptr;
  const intptr_t size = plugin.dispatch(effGetChunk, program_only ? 1 : 0, 0, &address);
  if (size <= 0 || address == nullptr) return {};
  const uint8_t* bytes = static_cast<const uint8_t*>(address);
  return std::vector<uint8_t>(bytes, bytes + size);
}

// The chunk copied into a buffer of exactly its size, as a host reading it
// from a session file would hold it.
intptr_t give_chunk(HostedPlugin& plugin, const std::vector<uint8_t>& chunk, bool program_only) {
  std::vector<uint8_t> copy(chunk);
  return plugin.dispatch(effSetChunk, program_only ? 1 : 0, static_cast<intptr_t>(copy.size()),
                         copy.empty() ? nullptr : copy.data());
}

// The fixed input after a restart: what the state alone makes of it.
std::vector<std::vector<float>> sound_of(PluginDriver& driver) {
  driver.restart();
  return render_blocks(driver, fixed_input(kFrames, kRate), kBlock, ProcessMode::replacing);
}

// A state no instance starts in: a random program, then random values.
void scramble(PluginDriver& driver, BatteryRandom& random) {
  HostedPlugin& plugin = driver.plugin();
  if (plugin.num_programs() > 1) {
    plugin.set_program(1 + static_cast<int>(random() % static_cast<uint32_t>(plugin.num_programs() - 1)));
  }
  driver.randomize_parameters(random);
}

void check_round_trip(const ValidateOptions& options, CheckRecorder& recorder, bool program_only) {
  const std::string name = program_only ? "state.program_chunk" : "state.bank_chunk";
  BatteryRandom random(options.seed + (program_only ? 11 : 13));
  const int trials = scaled_count(options, 3);
  for (int trial = 0; trial < trials; ++trial) {
    PluginDriver source(options.plugin_path, kRate, kBlock);
    scramble(source, random);
    const std::vector<uint8_t> chunk = take_chunk(source.plugin(), program_only);
    if (chunk.empty()) {
      recorder.skip(name, "the plug-in hands out no chunk");
      return;
    }
    const auto expected = sound_of(source);
    PluginDriver target(options.plugin_path, kRate, kBlock);
    // A host restores the program number beside the chunk, which holds the
    // programs themselves.
    if (source.plugin().num_programs() > 0) {
      target.plugin().set_program(static_cast<int>(source.plugin().dispatch(effGetProgram)));
    }
    if (give_chunk(target.plugin(), chunk, program_only) == 0) {
      recorder.fail(name, "a fresh instance refused the " + std::to_string(chunk.size()) +
                              "-byte chunk another instance handed out");
      return;
    }
    const std::string difference = first_difference(expected, sound_of(target));
    if (!difference.empty()) {
      recorder.fail(name, "trial " + std::to_string(trial + 1) + ": the instance restored from the chunk sounds different: " +
                              difference);
      return;
    }
    const std::vector<uint8_t> again = take_chunk(target.plugin(), program_only);
    if (again != chunk) {
      recorder.fail(name, "the restored instance hands out a different chunk (" +
                              std::to_string(again.size()) + " bytes against " +
                              std::to_string(chunk.size()) + ")");
      return;
    }
  }
  recorder.pass(name, std::to_string(trials) + " chunks moved to fresh instances: bit-identical output and chunk");
}

// Chunks that must be refused: random bytes of random lengths and every kind
// of cut of a valid chunk. State is compared before and after.
void check_bad_chunks(const ValidateOptions& options, CheckRecorder& recorder, bool program_only) {
  const std::string name = program_only ? "state.bad_program_chunks" : "state.bad_bank_chunks";
  BatteryRandom random(options.seed + (program_only ? 17 : 19));
  PluginDriver driver(options.plugin_path, kRate, kBlock);
  scramble(driver, random);
  const std::vector<uint8_t> valid = take_chunk(driver.plugin(), program_only);
  if (valid.empty()) {
    recorder.skip(name, "the plug-in hands out no chunk");
    return;
  }
  const auto expected = sound_of(driver);
  std::vector<std::vector<uint8_t>> bad;
  const int random_count = scaled_count(options, 40);
  for (int i = 0; i < random_count; ++i) {
    std::vector<uint8_t> bytes(1 + random() % (2 * valid.size()));
    for (auto& byte : bytes) byte = static_cast<uint8_t>(random());
    bad.push_back(bytes);
  }
  // Cuts: near the start, through the middle, one byte short.
  std::vector<size_t> cuts = {1, 2, 3, 4, 7, 8, 12, valid.size() / 2, valid.size() - 1};
  for (int i = 0; i < scaled_count(options, 20); ++i) cuts.push_back(1 + random() % (valid.size() - 1));
  for (size_t cut : cuts) {
    if (cut > 0 && cut < valid.size()) bad.emplace_back(valid.begin(), valid.begin() + static_cast<long>(cut));
  }
  int accepted = 0;
  std::string first_accepted;
  for (const auto& bytes : bad) {
    if (give_chunk(driver.plugin(), bytes, program_only) != 0) {
      if (accepted++ == 0) first_accepted = std::to_string(bytes.size()) + " bytes";
    }
  }
  if (accepted > 0) {
    recorder.fail(name, std::to_string(accepted) + " of " + std::to_string(bad.size()) +
                            " random or cut chunks accepted (first: " + first_accepted + ")");
    return;
  }
  if (take_chunk(driver.plugin(), program_only) != valid) {
    recorder.fail(name, "refused chunks changed the state the plug-in hands out");
    return;
  }
  const std::string difference = first_difference(expected, sound_of(driver));
  if (!difference.empty()) {
    recorder.fail(name, "refused chunks changed the sound: " + difference);
    return;
  }
  recorder.pass(name, std::to_string(bad.size()) + " random and cut chunks refused; state unchanged");
}

// Programs switched between blocks; the one left in effect must sound as on
// a fresh instance that only selected it.
void check_program_switching(const ValidateOptions& options, CheckRecorder& recorder) {
  const char* name = "state.program_switch";
  PluginDriver driver(options.plugin_path, kRate, kBlock);
  const int programs = driver.plugin().num_programs();
  if (programs < 2) {
    recorder.skip(name, "fewer than two programs");
    return;
  }
  BatteryRandom random(options.seed + 23);
  const float bound = db_to_amplitude(80.0);
  long position = 0;
  const int switches = scaled_count(options, 60);
  int last = 0;
  for (int i = 0; i < switches; ++i) {
    last = static_cast<int>(random() % static_cast<uint32_t>(programs));
    driver.plugin().set_program(last);
    const int frames = 1 + static_cast<int>(random() % kBlock);
    for (int channel = 0; channel < 2; ++channel) {
      fill_test_signal(driver.input(channel), frames, channel, position, kRate);
    }
    driver.process(frames, ProcessMode::replacing);
    position += frames;
    const std::string problem = driver.check_outputs(frames, bound);
    if (!problem.empty()) {
      recorder.fail(name, "after switching to program " + std::to_string(last) + ": " + problem);
      return;
    }
  }
  if (driver.plugin().dispatch(effGetProgram) != last) {
    recorder.fail(name, "effGetProgram answers " + std::to_string(driver.plugin().dispatch(effGetProgram)) +
                            " after selecting " + std::to_string(last));
    return;
  }
  PluginDriver fresh(options.plugin_path, kRate, kBlock);
  fresh.plugin().set_program(last);
  const std::string difference = first_difference(sound_of(fresh), sound_of(driver));
  if (!difference.empty()) {
    recorder.fail(name, "program " + std::to_string(last) + " reached by switching sounds unlike a fresh selection: " +
                            difference);
    return;
  }
  recorder.pass(name, std::to_string(switches) + " program switches between blocks; the last one sounds as when freshly selected");
}

}  // namespace

void run_state_checks(const ValidateOptions& options, CheckRecorder& recorder) {
  guarded(recorder, "state.bank_chunk", [&] { check_round_trip(options, recorder, false); });
  guarded(recorder, "state.program_chunk", [&] { check_round_trip(options, recorder, true); });
  guarded(recorder, "state.bad_bank_chunks", [&] { check_bad_chunks(options, recorder, false); });
  guarded(recorder, "state.bad_program_chunks", [&] { check_bad_chunks(options, recorder, true); });
  guarded(recorder, "state.program_switch", [&] { check_program_switching(options, recorder); });
}

}  // namespace plugcore
