// Windows console test host: renders interleaved stereo float32 raw audio
// through a plug-in DLL with the same host callback and render loop as the
// Linux command-line host, so the two platforms' outputs can be compared.
//
//   win_render_host PLUGIN.dll IN.raw OUT.raw [--program N] [--norm I=V]...
//                   [--rate HZ] [--block N] [--mode replacing|adding]
//   win_render_host PLUGIN.dll --info
//   win_render_host PLUGIN.dll --snapshot OUT.bmp [--program N] [--norm I=V]...
//
// The snapshot mode opens the editor in a parent window of its size the way
// a host does, idles it every 20 ms for 0.3 s while pumping messages, copies
// the window into a device-independent bitmap and writes it as a 24-bit BMP.
#include <cstdio>
#include <cstdlib>
#include <cstdint>
#include <exception>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

#include "cli/editor_parent.h"
#include "cli/hosted_plugin.h"
#include "cli/param_lookup.h"
#include "cli/raw_audio.h"
#include "cli/render_loop.h"
#include "cli/validate/editor_session.h"

namespace {

const char kUsage[] =
    "usage: win_render_host PLUGIN.dll IN.raw OUT.raw [--program N] [--norm I=V]...\n"
    "                       [--rate HZ] [--block N] [--mode replacing|adding]\n"
    "       win_render_host PLUGIN.dll --info\n"
    "       win_render_host PLUGIN.dll --snapshot OUT.bmp [--program N] [--norm I=V]...\n";

long parse_long(const std::string& text, const char* option) {
  char* end = nullptr;
  const long value = std::strtol(text.c_str(), &end, 10);
  if (text.empty() || *end != '\0') {
    throw std::runtime_error(std::string(option) + " expects a whole number, got \"" + text + "\"");
  }
  return value;
}

int print_info(const std::string& plugin_path) {
  plugcore::HostedPlugin plugin(plugin_path, 48000.0, 512);
  std::printf("numParams %d\nnumPrograms %d\nnumInputs %d\nnumOutputs %d\nflags %d\nuniqueID %d\n",
              plugin.num_params(), plugin.num_programs(), plugin.num_inputs(),
              plugin.num_outputs(), static_cast<int>(plugin.flags()),
              static_cast<int>(plugin.effect()->uniqueID));
  return 0;
}

void put_le(std::vector<unsigned char>& bytes, uint32_t value, int count) {
  for (int i = 0; i < count; ++i) bytes.push_back(static_cast<unsigned char>(value >> (8 * i)));
}

// Bottom-up 24-bit BMP, rows padded to four bytes.
void write_bmp(const std::string& path, const plugcore::PixelImage& image) {
  const uint32_t row = (static_cast<uint32_t>(image.width) * 3 + 3) & ~3u;
  const uint32_t data_size = row * static_cast<uint32_t>(image.height);
  std::vector<unsigned char> bytes;
  bytes.push_back('B');
  bytes.push_back('M');
  put_le(bytes, 54 + data_size, 4);
  put_le(bytes, 0, 4);
  put_le(bytes, 54, 4);
  put_le(bytes, 40, 4);
  put_le(bytes, static_cast<uint32_t>(image.width), 4);
  put_le(bytes, static_cast<uint32_t>(image.height), 4);
  put_le(bytes, 1, 2);
  put_le(bytes, 24, 2);
  put_le(bytes, 0, 4);
  put_le(bytes, data_size, 4);
  put_le(bytes, 2835, 4);
  put_le(bytes, 2835, 4);
  put_le(bytes, 0, 4);
  put_le(bytes, 0, 4);
  for (int y = image.height - 1; y >= 0; --y) {
    const size_t start = bytes.size();
    for (int x = 0; x < image.width; ++x) put_le(bytes, image.at(x, y), 3);  // blue, green, red
    bytes.resize(start + row, 0);
  }
  FILE* file = std::fopen(path.c_str(), "wb");
  if (file == nullptr) throw std::runtime_error("cannot write " + path);
  const size_t written = std::fwrite(bytes.data(), 1, bytes.size(), file);
  if (std::fclose(file) != 0 || written != bytes.size()) throw std::runtime_error("cannot write " + path);
}

int snapshot(const std::vector<std::string>& args) {
  const std::string plugin_path = args[0];
  const std::string out_path = args[2];
  plugcore::ParamSettings settings;
  for (size_t i = 3; i < args.size(); ++i) {
    const std::string& option = args[i];
    if (i + 1 >= args.size()) throw std::runtime_error(option + " needs a value");
    const std::string value = args[++i];
    if (option == "--program") {
      settings.program = static_cast<int>(parse_long(value, "--program"));
    } else if (option == "--norm") {
      settings.norms.push_back(plugcore::parse_norm_assignment(value));
    } else {
      throw std::runtime_error("unknown option " + option);
    }
  }
  plugcore::HostedPlugin plugin(plugin_path, 48000.0, 512);
  plugcore::apply_settings(plugin, settings);
  plugin.resume();
  const plugcore::EditorSize size = plugcore::query_editor_size(plugin);
  const std::unique_ptr<plugcore::EditorParentInterface> parent =
      plugcore::create_editor_parent(size.width, size.height, "snapshot");
  plugcore::PixelImage image;
  {
    plugcore::EditorSession editor(plugin, *parent);
    editor.run_for(0.3, 20);
    image = parent->grab();
  }
  write_bmp(out_path, image);
  std::printf("%s: %dx%d editor snapshot\n", out_path.c_str(), image.width, image.height);
  return 0;
}

int render(const std::vector<std::string>& args) {
  const std::string plugin_path = args[0];
  const std::string in_path = args[1];
  const std::string out_path = args[2];
  plugcore::ParamSettings settings;
  double rate = 48000.0;
  int block = 512;
  plugcore::ProcessMode mode = plugcore::ProcessMode::replacing;
  for (size_t i = 3; i < args.size(); ++i) {
    const std::string& option = args[i];
    if (i + 1 >= args.size()) {
      throw std::runtime_error(option + " needs a value");
    }
    const std::string value = args[++i];
    if (option == "--program") {
      settings.program = static_cast<int>(parse_long(value, "--program"));
    } else if (option == "--norm") {
      settings.norms.push_back(plugcore::parse_norm_assignment(value));
    } else if (option == "--rate") {
      rate = static_cast<double>(parse_long(value, "--rate"));
    } else if (option == "--block") {
      block = static_cast<int>(parse_long(value, "--block"));
    } else if (option == "--mode") {
      if (value != "replacing" && value != "adding") {
        throw std::runtime_error("--mode expects replacing or adding");
      }
      mode = value == "adding" ? plugcore::ProcessMode::adding : plugcore::ProcessMode::replacing;
    } else {
      throw std::runtime_error("unknown option " + option);
    }
  }
  if (rate <= 0.0 || block <= 0) {
    throw std::runtime_error("rate and block size must be positive");
  }
  const std::vector<std::vector<float>> input = basic::read_raw_float(in_path, 2);
  plugcore::HostedPlugin plugin(plugin_path, rate, block);
  plugcore::apply_settings(plugin, settings);
  plugcore::RenderLoop loop(plugin, block, mode);
  std::vector<std::vector<float>> output;
  plugin.resume();
  loop.run(input[0].data(), input[1].data(), input[0].size(), output);
  plugin.suspend();
  // Always two channels out; a one-output plug-in's signal is copied to both.
  if (output.size() == 1) {
    output.push_back(output[0]);
  }
  output.resize(2);
  basic::write_raw_float(out_path, output);
  return 0;
}

}  // namespace

int main(int argc, char** argv) {
  const std::vector<std::string> args(argv + 1, argv + argc);
  try {
    if (args.size() == 2 && args[1] == "--info") {
      return print_info(args[0]);
    }
    if (args.size() < 3) {
      std::fputs(kUsage, stderr);
      return 2;
    }
    if (args[1] == "--snapshot") return snapshot(args);
    return render(args);
  } catch (const std::exception& error) {
    std::fprintf(stderr, "win_render_host: %s\n", error.what());
    return 1;
  }
}
