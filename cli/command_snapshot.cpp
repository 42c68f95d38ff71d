// brakmorph snapshot: the editor opened in a real parent window the way a
// host opens it, idled for a while so it paints, grabbed into a PNG.
#include <iostream>

#include "cli/command_args.h"
#include "cli/command_common.h"
#include "cli/commands.h"
#include "cli/validate/editor_session.h"
#include "cli/hosted_plugin.h"
#include "cli/png_file.h"

namespace plugcore {
namespace {

constexpr int kIdlePeriodMs = 20;

struct SnapshotOptions {
  std::string plugin_path = default_plugin_path();
  std::string out_path;
  ParamSettings settings;
  double idle_seconds = 0.3;
};

SnapshotOptions parse(basic::ArgReader& args) {
  SnapshotOptions options;
  while (!args.done()) {
    const std::string option = args.next();
    if (take_setting_option(option, args, options.settings)) {
      continue;
    } else if (option == "--plugin") {
      options.plugin_path = args.value(option);
    } else if (option == "--out") {
      options.out_path = args.value(option);
    } else if (option == "--idle") {
      options.idle_seconds = basic::parse_double(args.value(option), option, 0.02, 60.0);
    } else {
      throw basic::UsageError("snapshot: unknown option " + option);
    }
  }
  if (options.out_path.empty()) throw basic::UsageError("snapshot: --out is required");
  return options;
}

}  // namespace

int run_snapshot(basic::ArgReader& args) {
  const SnapshotOptions options = parse(args);
  HostedPlugin plugin(options.plugin_path, 48000.0, 512);
  apply_settings(plugin, options.settings);
  plugin.resume();
  const EditorSize size = query_editor_size(plugin);
  const std::unique_ptr<EditorParentInterface> parent =
      create_editor_parent(size.width, size.height, plugin.effect_name() + " snapshot");
  PixelImage image;
  {
    EditorSession editor(plugin, *parent);
    editor.run_for(options.idle_seconds, kIdlePeriodMs);
    // Some editors settle their size only once open.
    const EditorSize open_size = query_editor_size(plugin);
    if (open_size.width != size.width || open_size.height != size.height) {
      parent->resize(open_size.width, open_size.height);
      editor.run_for(options.idle_seconds, kIdlePeriodMs);
    }
    image = parent->grab();
  }
  write_png(options.out_path, image);
  std::cout << options.out_path << ": " << image.width << "x" << image.height << " editor snapshot\n";
  return 0;
}

}  // namespace plugcore
