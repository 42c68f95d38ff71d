// Running the command-line host as a subprocess and handling the files it
// reads and writes, for the host's tests.
#pragma once

#include <sndfile.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdint>
#include <cstdio>
#include <cstring>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

namespace cli_test {

struct RunResult {
  int status = -1;  // exit status, or -1 when the process did not exit normally
  std::string out;
  std::string err;
};

inline std::string read_text(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  std::ostringstream text;
  text << in.rdbuf();
  return text.str();
}

inline std::string cli_path() { return BRAKMORPH_TEST_CLI; }

// Paths of the fake plug-in builds; the build passes them in, otherwise they
// are looked for where the fake plug-in's CMake snippet puts them.
inline std::string fake_plugin_path(bool main_only = false) {
#if defined(BRAKMORPH_TEST_FAKE_PLUGIN) && defined(BRAKMORPH_TEST_FAKE_PLUGIN_MAIN_ONLY)
  return main_only ? BRAKMORPH_TEST_FAKE_PLUGIN_MAIN_ONLY : BRAKMORPH_TEST_FAKE_PLUGIN;
#else
  const std::filesystem::path bin = std::filesystem::path(cli_path()).parent_path();
  return (bin / ".." / "test_plugins" / (main_only ? "FakeGainMainOnly.so" : "FakeGain.so"))
      .string();
#endif
}

// Runs the host with args; env entries are NAME=VALUE additions for the child.
inline RunResult run_cli(const std::vector<std::string>& args, const std::string& work_dir,
                         const std::vector<std::pair<std::string, std::string>>& env = {}) {
  const std::string out_path = work_dir + "/.stdout";
  const std::string err_path = work_dir + "/.stderr";
  std::fflush(nullptr);
  const pid_t child = fork();
  if (child == 0) {
    for (const auto& entry : env) setenv(entry.first.c_str(), entry.second.c_str(), 1);
    if (!freopen(out_path.c_str(), "w", stdout) || !freopen(err_path.c_str(), "w", stderr)) {
      _exit(127);
    }
    std::vector<std::string> argv_text = {cli_path()};
    argv_text.insert(argv_text.end(), args.begin(), args.end());
    std::vector<char*> argv;
    for (auto& text : argv_text) argv.push_back(&text[0]);
    argv.push_back(nullptr);
    execv(argv[0], argv.data());
    _exit(127);
  }
  RunResult result;
  int wait_status = 0;
  if (child > 0 && waitpid(child, &wait_status, 0) == child && WIFEXITED(wait_status)) {
    result.status = WEXITSTATUS(wait_status);
  }
  result.out = read_text(out_path);
  result.err = read_text(err_path);
  return result;
}

struct Audio {
  int rate = 0;
  int format = 0;
  std::vector<std::vector<float>> channels;
  size_t frames() const { return channels.empty() ? 0 : channels[0].size(); }
};

inline bool write_wav(const std::string& path, int rate,
                      const std::vector<std::vector<float>>& channels,
                      int format = SF_FORMAT_WAV | SF_FORMAT_FLOAT) {
  SF_INFO info{};
  info.samplerate = rate;
  info.channels = static_cast<int>(channels.size());
  info.format = format;
  SNDFILE* file = sf_open(path.c_str(), SFM_WRITE, &info);
  if (file == nullptr) return false;
  const size_t frames = channels[0].size();
  std::vector<float> interleaved;
  for (size_t n = 0; n < frames; ++n)
    for (const auto& channel : channels) interleaved.push_back(channel[n]);
  const sf_count_t written = sf_writef_float(file, interleaved.data(), static_cast<sf_count_t>(frames));
  sf_close(file);
  return written == static_cast<sf_count_t>(frames);
}

inline Audio read_wav(const std::string& path) {
  Audio audio;
  SF_INFO info{};
  SNDFILE* file = sf_open(path.c_str(), SFM_READ, &info);
  if (file == nullptr) return audio;
  audio.rate = info.samplerate;
  audio.format = info.format;
  std::vector<float> interleaved(static_cast<size_t>(info.frames) * static_cast<size_t>(info.channels));
  sf_readf_float(file, interleaved.data(), info.frames);
  sf_close(file);
  audio.channels.assign(static_cast<size_t>(info.channels),
                        std::vector<float>(static_cast<size_t>(info.frames)));
  for (size_t n = 0; n < static_cast<size_t>(info.frames); ++n)
    for (size_t c = 0; c < audio.channels.size(); ++c)
      audio.channels[c][n] = interleaved[n * audio.channels.size() + c];
  return audio;
}

// Deterministic test noise in -amplitude..amplitude.
inline std::vector<float> test_noise(size_t frames, uint32_t seed, float amplitude) {
  std::vector<float> noise(frames);
  for (float& sample : noise) {
    seed = seed * 747796405u + 2891336453u;
    sample = amplitude * (static_cast<float>(seed >> 9) / 4194304.0f - 1.0f);
  }
  return noise;
}

// A scratch directory removed when the test ends.
class ScratchDir {
 public:
  ScratchDir() {
    std::string pattern = (std::filesystem::temp_directory_path() / "brakmorph-cli-XXXXXX").string();
    if (mkdtemp(&pattern[0]) != nullptr) path_ = pattern;
  }
  ~ScratchDir() {
    std::error_code ignored;
    if (!path_.empty()) std::filesystem::remove_all(path_, ignored);
  }
  const std::string& path() const { return path_; }
  std::string file(const std::string& name) const { return path_ + "/" + name; }

 private:
  std::string path_;
};

// Files in dir other than the host's captured stdout/stderr.
inline std::vector<std::string> listed_files(const std::string& dir) {
  std::vector<std::string> names;
  for (const auto& entry : std::filesystem::directory_iterator(dir)) {
    const std::string name = entry.path().filename().string();
    if (name != ".stdout" && name != ".stderr") names.push_back(name);
  }
  return names;
}

// A bank block in the preset bank layout: big-endian count, record size,
// then records with a 64-byte name field and the given values.
inline std::vector<uint8_t> bank_block(const std::vector<std::string>& names,
                                       const std::vector<std::vector<float>>& values) {
  auto put32 = [](std::vector<uint8_t>& out, uint32_t v) {
    for (int k = 3; k >= 0; --k) out.push_back(static_cast<uint8_t>(v >> (8 * k)));
  };
  const uint32_t value_count = static_cast<uint32_t>(values.empty() ? 0 : values[0].size());
  const uint32_t record = 76 + 4 * value_count;
  std::vector<uint8_t> block;
  put32(block, static_cast<uint32_t>(names.size()));
  put32(block, names.empty() ? 0 : record);
  for (size_t i = 0; i < names.size(); ++i) {
    put32(block, 0);
    block.push_back(0), block.push_back(64);
    block.push_back(static_cast<uint8_t>(value_count >> 8)), block.push_back(static_cast<uint8_t>(value_count));
    put32(block, 0);
    std::vector<uint8_t> name(64, 0);
    for (size_t k = 0; k < names[i].size() && k < 63; ++k) name[k] = static_cast<uint8_t>(names[i][k]);
    block.insert(block.end(), name.begin(), name.end());
    for (float v : values[i]) {
      uint32_t bits;
      std::memcpy(&bits, &v, 4);
      put32(block, bits);
    }
  }
  return block;
}

inline void write_bytes(const std::string& path, const std::vector<uint8_t>& bytes) {
  std::ofstream out(path, std::ios::binary);
  out.write(reinterpret_cast<const char*>(bytes.data()), static_cast<std::streamsize>(bytes.size()));
}

// "VLPB", the big-endian block length, the block.
inline std::vector<uint8_t> bank_file(const std::vector<uint8_t>& block) {
  std::vector<uint8_t> file = {'V', 'L', 'P', 'B'};
  const uint32_t length = static_cast<uint32_t>(block.size());
  for (int k = 3; k >= 0; --k) file.push_back(static_cast<uint8_t>(length >> (8 * k)));
  file.insert(file.end(), block.begin(), block.end());
  return file;
}

inline std::vector<std::string> lines_of(const std::string& text) {
  std::vector<std::string> lines;
  std::istringstream in(text);
  std::string line;
  while (std::getline(in, line)) lines.push_back(line);
  return lines;
}

}  // namespace cli_test
