// The text of brakmorph --help and of each command's --help.
#include <string>

#include "cli/commands.h"

namespace plugcore {
namespace {

struct HelpEntry {
  const char* command;
  const char* text;
};

const HelpEntry kHelp[] = {
    {"",
     "usage: brakmorph COMMAND [OPTIONS]\n"
     "\n"
     "Loads a VST 2 plug-in the way a host does and drives it from the command line.\n"
     "Without --plugin the Brakmorph plug-in next to this program is used\n"
     "(<dir of brakmorph>/../vst/Brakmorph.so).\n"
     "\n"
     "commands:\n"
     "  info      what the plug-in declares: id, flags, pins, parameters, programs\n"
     "  render    process a file (or the built-in demo signal) into a 32-bit float WAV\n"
     "  demo      render the demo signal through every program\n"
     "  bench     measure processing CPU time, several configurations side by side\n"
     "  bank      show the programs of a preset bank file\n"
     "  validate  run the host-grade validation battery on a plug-in\n"
     "  snapshot  open the plug-in's editor in a window and save a PNG of it\n"
     "  edit      open the plug-in's editor while a file plays through it\n"
     "\n"
     "'brakmorph COMMAND --help' describes a command. Failures exit non-zero with\n"
     "a one-line reason (status 2 for a command-line mistake).\n"},
    {"info",
     "usage: brakmorph info [--plugin P] [--json]\n"
     "\n"
     "Prints the unique id (four characters and number), version, flags by name,\n"
     "inputs and outputs with their pin labels, every parameter (index, name,\n"
     "display of the current value, label, whether it can be automated, switch /\n"
     "integer range / stepped from its properties) and the programs by name.\n"
     "  --json    the same as one JSON object\n"},
    {"render",
     "usage: brakmorph render [--plugin P] [--in IN | --raw-in IN.raw] (--out OUT.wav | --raw-out OUT.raw)\n"
     "                        [--program N] [--set NAME=TEXT]... [--norm INDEX=VALUE]...\n"
     "                        [--rate HZ] [--block N] [--mode replacing|adding]\n"
     "                        [--mono-in] [--mono-out] [--tail SECONDS]\n"
     "                        [--midi FILE.mid] [--settings FILE.cfg.txt]\n"
     "\n"
     "Processes IN (any format the audio file library reads; a mono file feeds both\n"
     "inputs, beyond two channels the first two are used) or, without an input, the\n"
     "built-in demo signal, and writes a 32-bit float WAV at the input's rate.\n"
     "Settings apply in this order: program, then --set, then --norm.\n"
     "  --set NAME=TEXT     parameter by name (case-insensitive) through the plug-in's\n"
     "                      own text conversion, e.g. --set \"Master Vol=-6\"\n"
     "  --norm INDEX=VALUE  normalised value 0..1 by parameter index\n"
     "  --rate HZ           rate of the demo signal or of raw input (default 48000)\n"
     "  --block N           frames per process call (default 512)\n"
     "  --mode              replacing (default) or adding (outputs zeroed before each call)\n"
     "  --mono-in           leave the second input unconnected\n"
     "  --mono-out          use only the first output: a one-channel file\n"
     "  --tail SECONDS      append that much silence to the input\n"
     "  --raw-in/--raw-out  headerless interleaved stereo float32 little-endian audio\n"
     "  --midi FILE.mid     send the file's channel messages (CC, RPN, NRPN...) to the\n"
     "                      plug-in at their sample offsets (formats 0 and 1, tempo map)\n"
     "  --settings FILE     load a setting file (the MIDI control map) before rendering\n"
     "The output is written next to OUT under a temporary name and renamed when\n"
     "complete. The last line gives the output's peak and RMS level in dBFS.\n"},
    {"demo",
     "usage: brakmorph demo [--plugin P] [--out-dir DIR] [--rate HZ] [--block N]\n"
     "\n"
     "Renders the built-in demo signal (6 s of bass, drums and guitar) through each\n"
     "program into DIR/program-N.wav (default DIR: out/demo) and prints each file's\n"
     "peak and RMS level.\n"},
    {"bench",
     "usage: brakmorph bench [--plugin P] [--program N] [--set NAME=TEXT]... [--norm I=V]...\n"
     "                       [--seconds S] [--rate HZ] [--block N] [--runs N]\n"
     "                       [--case \"NAME:key=value,...\"]... [--compare P2]...\n"
     "\n"
     "Processes S seconds (default 2) of fixed-seed stereo noise and measures the\n"
     "processing thread's CPU time. Prints, per configuration, the median of --runs\n"
     "runs (default 5) as audio seconds per CPU second (x realtime), nanoseconds per\n"
     "stereo frame, and the cost relative to the first configuration.\n"
     "\n"
     "Without --case the options above form one configuration, \"base\". Each --case\n"
     "adds a configuration instead, starting from the plug-in and block given above\n"
     "with its own settings; keys: plugin=PATH, program=N, set=NAME=TEXT,\n"
     "norm=INDEX=VALUE, block=N, mode=replacing|adding (set and norm may repeat).\n"
     "Each --compare P2 adds the plug-in P2 in its start-up state.\n"
     "All instances stay loaded and their runs are interleaved, so machine noise\n"
     "affects every configuration alike. Example:\n"
     "  brakmorph bench --case \"plain:program=3\" \\\n"
     "                  --case \"os:program=3,set=Oversampling=On\"\n"},
    {"validate",
     "usage: brakmorph validate [--plugin P] [--strictness 1..10] [--seed N] [--only G,G] [--json]\n"
     "\n"
     "Drives the plug-in the way the strictest hosts do and prints one line per\n"
     "check (PASS, FAIL or SKIP with the reason), then \"N passed, N failed\".\n"
     "Exits 1 when any check failed. Groups: lifecycle, dispatcher, audio,\n"
     "threads, state, realtime, editor (skipped without a desktop).\n"
     "  --strictness  how many trials each check makes (10, the default, is the most)\n"
     "  --seed        seed of every random choice (default 1)\n"
     "  --only        run only the named groups\n"
     "  --json        the results as one JSON object\n"},
    {"bank",
     "usage: brakmorph bank show FILE.pbk [--plugin P]\n"
     "\n"
     "Checks the bank file's header, hands its bank block to the plug-in as a bank\n"
     "chunk and lists every program with its parameter values as the plug-in's own\n"
     "display texts. A bad file is reported with its status code: -1002 cannot open,\n"
     "-1005 short header, -1009 short block, -1010 bad magic, -1007 refused by the\n"
     "plug-in.\n"},
    {"snapshot",
     "usage: brakmorph snapshot --out FILE.png [--plugin P] [--program N] [--set NAME=TEXT]...\n"
     "                          [--norm INDEX=VALUE]... [--idle SECONDS]\n"
     "\n"
     "Applies the settings, asks the editor for its size, makes a window of that\n"
     "size as the editor's parent, opens the editor in it, idles it every 20 ms\n"
     "for --idle seconds (default 0.3) so it paints, grabs the window and writes\n"
     "an RGB PNG. Needs a desktop (DISPLAY; xvfb-run works).\n"},
    {"edit",
     "usage: brakmorph edit [--plugin P] [--in IN.wav] [--program N] [--set NAME=TEXT]...\n"
     "                      [--norm INDEX=VALUE]... [--seconds S]\n"
     "\n"
     "Opens the editor in a window for trying it by hand. A second thread plays\n"
     "IN (default: the demo signal) through the plug-in in a loop at the pace of\n"
     "real time, so meters move; nothing is heard. Ends when the window is closed\n"
     "or after --seconds, and prints how many blocks were played.\n"},
};

}  // namespace

std::string help_text(const std::string& command) {
  for (const HelpEntry& entry : kHelp) {
    if (command == entry.command) {
      return entry.text;
    }
  }
  return std::string();
}

}  // namespace plugcore
