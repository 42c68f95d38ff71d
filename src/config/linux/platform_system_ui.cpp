#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

#include "config/linux/fallback_dialogs_x11.h"
#include "config/system_ui.h"

extern char** environ;

namespace sys {

namespace {

bool has_display() {
  const char* name = std::getenv("DISPLAY");
  return name != nullptr && *name != '\0';
}

// BRAKMORPH_NO_DESKTOP_TOOLS=1 keeps the desktop's dialog programs out of it.
bool tools_allowed() {
  const char* off = std::getenv("BRAKMORPH_NO_DESKTOP_TOOLS");
  return off == nullptr || std::strcmp(off, "1") != 0;
}

bool on_path(const std::string& program) {
  const char* path = std::getenv("PATH");
  if (!path) return false;
  std::string dirs = path;
  size_t start = 0;
  while (start <= dirs.size()) {
    size_t end = dirs.find(':', start);
    if (end == std::string::npos) end = dirs.size();
    std::string dir = dirs.substr(start, end - start);
    if (!dir.empty() && access((dir + "/" + program).c_str(), X_OK) == 0) return true;
    start = end + 1;
  }
  return false;
}

struct RunResult {
  bool started = false;
  int exit_status = -1;
  std::string output;
};

// Runs the program, waits for it and keeps what it wrote on its standard output.
RunResult run(const std::vector<std::string>& args, bool wait_for_exit = true) {
  RunResult result;
  int pipe_fds[2];
  if (pipe(pipe_fds) != 0) return result;
  posix_spawn_file_actions_t actions;
  posix_spawn_file_actions_init(&actions);
  posix_spawn_file_actions_adddup2(&actions, pipe_fds[1], STDOUT_FILENO);
  posix_spawn_file_actions_addclose(&actions, pipe_fds[0]);
  std::vector<char*> argv;
  for (const std::string& a : args) argv.push_back(const_cast<char*>(a.c_str()));
  argv.push_back(nullptr);
  pid_t pid = 0;
  const int spawned = posix_spawnp(&pid, argv[0], &actions, nullptr, argv.data(), environ);
  posix_spawn_file_actions_destroy(&actions);
  close(pipe_fds[1]);
  if (spawned != 0) {
    close(pipe_fds[0]);
    return result;
  }
  result.started = true;
  if (!wait_for_exit) {
    close(pipe_fds[0]);
    // The browser launcher may run on: it is reaped on a later call, not waited for.
    static std::vector<pid_t> running;
    for (size_t i = 0; i < running.size();) {
      if (waitpid(running[i], nullptr, WNOHANG) != 0) {
        running.erase(running.begin() + static_cast<std::ptrdiff_t>(i));
      } else {
        ++i;
      }
    }
    running.push_back(pid);
    return result;
  }
  char buffer[512];
  for (;;) {
    ssize_t n = read(pipe_fds[0], buffer, sizeof buffer);
    if (n <= 0) break;
    result.output.append(buffer, static_cast<size_t>(n));
  }
  close(pipe_fds[0]);
  int status = 0;
  if (waitpid(pid, &status, 0) == pid && WIFEXITED(status)) result.exit_status = WEXITSTATUS(status);
  return result;
}

std::string first_line(const std::string& text) {
  size_t end = text.find('\n');
  return end == std::string::npos ? text : text.substr(0, end);
}

std::string join_path(const std::string& directory, const std::string& name) {
  if (directory.empty()) return name;
  return directory.back() == '/' ? directory + name : directory + "/" + name;
}

// Patterns are listed with ',' or ';' between them; the tools want blanks.
std::string patterns(const std::string& pattern) {
  std::string out = pattern;
  for (char& c : out) {
    if (c == ',' || c == ';') c = ' ';
  }
  return out;
}

class DesktopSystemUi : public SystemUiInterface {
 public:
  FileDialogResult run_file_dialog(const FileDialogRequest& request) override {
    FileDialogResult result;
    result.filter_index = request.filter_index;
    result.status = -1024;
    if (!has_display()) return result;
    std::vector<std::string> args;
    const std::string start = join_path(request.directory, request.file_name);
    const bool tools = tools_allowed();
    if (tools && on_path("zenity")) {
      args = {"zenity", "--file-selection", "--title=" + request.title};
      if (request.save) args.push_back("--save");
      if (!start.empty()) args.push_back("--filename=" + start);
      for (size_t i = 0; i < request.filters.size(); ++i) {
        const FileFilter& f = request.filters[(i + static_cast<size_t>(request.filter_index)) % request.filters.size()];
        args.push_back("--file-filter=" + f.description + " | " + patterns(f.pattern));
      }
    } else if (tools && on_path("kdialog")) {
      args = {"kdialog", request.save ? "--getsavefilename" : "--getopenfilename", start.empty() ? "." : start};
      std::string filter;
      for (const FileFilter& f : request.filters) {
        if (!filter.empty()) filter += "\n";
        filter += patterns(f.pattern) + "|" + f.description;
      }
      if (!filter.empty()) args.push_back(filter);
      if (!request.title.empty()) args.insert(args.end(), {"--title", request.title});
    } else {
      // Neither program (or they are switched off): the dialog we draw ourselves.
      return run_fallback_file_dialog(request);
    }
    RunResult r = run(args);
    if (!r.started) return result;
    std::string path = first_line(r.output);
    if (r.exit_status == 0 && !path.empty()) {
      result.status = 0;
      result.path = path;
    } else if (r.exit_status == 1 || (r.exit_status == 0 && path.empty())) {
      result.status = 1;
    }
    return result;
  }

  int32_t show_message_box(const std::string& title, const std::string& text, int32_t buttons,
                           int32_t default_button) override {
    if (!has_display()) return -1;
    std::vector<std::string> args;
    const bool tools = tools_allowed();
    if (tools && on_path("zenity")) {
      const char* kind = buttons == 0 ? "--info" : "--question";
      args = {"zenity", kind, "--title=" + title, "--text=" + text, "--no-markup"};
      if (buttons == 1) args.insert(args.end(), {"--ok-label=OK", "--cancel-label=Cancel"});
      if (buttons == 2) args.insert(args.end(), {"--ok-label=Yes", "--cancel-label=No"});
      if (buttons != 0 && default_button == 1) args.push_back("--default-cancel");
    } else if (tools && on_path("kdialog")) {
      args = {"kdialog", "--title", title, buttons == 0 ? "--msgbox" : (buttons == 1 ? "--okcancel" : "--yesno"), text};
    } else {
      return show_fallback_message_box(title, text, buttons, default_button);
    }
    RunResult r = run(args);
    if (!r.started || r.exit_status < 0) return -1;
    if (buttons == 0) return r.exit_status == 0 ? 0 : -1;
    return r.exit_status == 0 ? 0 : (r.exit_status == 1 ? 1 : -1);
  }

  int32_t open_url(const std::string& address) override {
    if (address.empty() || !on_path("xdg-open")) return -1;
    return run({"xdg-open", address}, false).started ? 0 : -1;
  }
};

}  // namespace

SystemUiInterface& platform_system_ui() {
  static DesktopSystemUi ui;
  return ui;
}

}  // namespace sys
