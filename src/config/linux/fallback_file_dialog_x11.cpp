#include <X11/keysym.h>
#include <sys/stat.h>

#include <algorithm>
#include <cstdlib>
#include <string>

#include "config/linux/dialog_window_x11.h"
#include "config/linux/fallback_dialogs_x11.h"

namespace sys {

namespace {

constexpr int kWidth = 560;
constexpr int kHeight = 112;
constexpr int kMargin = 12;
constexpr int kFieldLeft = 64;
constexpr int kFieldTop = 32;
constexpr int kFieldHeight = 22;
constexpr int kFieldInset = 4;
constexpr size_t kMaxPath = 1023;

constexpr uint32_t kBackground = 0xECECEC;
constexpr uint32_t kTextColour = 0x101010;
constexpr uint32_t kDimText = 0x6A6A6A;
constexpr uint32_t kNoteColour = 0xB00000;
constexpr uint32_t kFieldColour = 0xFFFFFF;
constexpr uint32_t kFieldEdge = 0x808080;
constexpr uint32_t kSelection = 0x30308C;
constexpr uint32_t kSelectedText = 0xFFFFFF;

std::string join_path(const std::string& directory, const std::string& name) {
  if (directory.empty()) return name;
  return directory.back() == '/' ? directory + name : directory + "/" + name;
}

// A typed name is read in the folder the dialog was opened in; "~/" is the home folder.
std::string resolve(const std::string& typed, const std::string& directory) {
  if (typed.compare(0, 2, "~/") == 0) {
    const char* home = std::getenv("HOME");
    if (home && *home) return join_path(home, typed.substr(2));
  }
  if (typed[0] == '/' || directory.empty()) return typed;
  return join_path(directory, typed);
}

bool is_folder(const std::string& path) {
  struct stat st {};
  return stat(path.c_str(), &st) == 0 && S_ISDIR(st.st_mode);
}

bool is_file(const std::string& path) {
  struct stat st {};
  return stat(path.c_str(), &st) == 0 && !S_ISDIR(st.st_mode);
}

std::string folder_of(const std::string& path) {
  const size_t slash = path.find_last_of('/');
  if (slash == std::string::npos) return std::string();
  return slash == 0 ? std::string("/") : path.substr(0, slash);
}

class FileDialogContent : public DialogContentInterface {
 public:
  explicit FileDialogContent(const FileDialogRequest& request) : request_(request) {
    text_ = join_path(request.directory, request.file_name).substr(0, kMaxPath);
    caret_ = text_.size();
    all_selected_ = !text_.empty();
    result_.filter_index = request.filter_index;
  }

  void paint(DialogWindowX11& w) override {
    w.fill(guikit::Rect{0, 0, kWidth, kHeight}, kBackground);
    const int lh = w.line_height();
    const std::string folder = request_.directory.empty() ? std::string("(current folder)") : request_.directory;
    w.text(guikit::Rect{kMargin, 10, kWidth - kMargin, 10 + lh}, "Folder:", kDimText);
    w.text(guikit::Rect{kFieldLeft, 10, kWidth - kMargin, 10 + lh}, folder, kTextColour);

    const int text_top = kFieldTop + (kFieldHeight - lh) / 2;
    w.text(guikit::Rect{kMargin, text_top, kFieldLeft, text_top + lh}, "File:", kDimText);
    paint_field(w, text_top, lh);

    int x = kFieldLeft;
    const int types_top = kFieldTop + kFieldHeight + 8;
    w.text(guikit::Rect{kMargin, types_top, kFieldLeft, types_top + w.line_height(true)}, "Types:", kDimText);
    for (size_t i = 0; i < request_.filters.size(); ++i) {
      // The selected type stands out in bold.
      const bool selected = static_cast<int32_t>(i) == request_.filter_index;
      std::string item = request_.filters[i].description;
      if (i + 1 < request_.filters.size()) item += ",  ";
      w.text(guikit::Rect{x, types_top, kWidth - kMargin, types_top + w.line_height(selected)}, item,
             selected ? kTextColour : kDimText, selected);
      x += w.text_width(item, selected);
    }

    const int bottom_top = kHeight - 10 - lh;
    w.text(guikit::Rect{kMargin, bottom_top, kWidth / 2, bottom_top + lh}, note_, kNoteColour);
    const std::string hint = "Return: choose    Escape: cancel";
    const int hint_left = kWidth - kMargin - w.text_width(hint);
    w.text(guikit::Rect{hint_left, bottom_top, kWidth - kMargin, bottom_top + lh}, hint, kDimText);
  }

  void key(unsigned long keysym, const std::string& chars) override {
    switch (keysym) {
      case XK_Return:
      case XK_KP_Enter:
        submit();
        return;
      case XK_Escape:
        close_requested();
        return;
      case XK_BackSpace:
        if (all_selected_) {
          clear();
        } else if (caret_ > 0) {
          text_.erase(--caret_, 1);
        }
        break;
      case XK_Delete:
      case XK_KP_Delete:
        if (all_selected_) {
          clear();
        } else if (caret_ < text_.size()) {
          text_.erase(caret_, 1);
        }
        break;
      case XK_Left:
      case XK_KP_Left:
        caret_ = all_selected_ ? 0 : (caret_ > 0 ? caret_ - 1 : 0);
        break;
      case XK_Right:
      case XK_KP_Right:
        caret_ = all_selected_ ? text_.size() : (caret_ < text_.size() ? caret_ + 1 : caret_);
        break;
      case XK_Home:
        caret_ = 0;
        break;
      case XK_End:
        caret_ = text_.size();
        break;
      default:
        for (char c : chars) {
          if (static_cast<unsigned char>(c) >= 32 && c != 127) insert(c);
        }
        if (chars.empty()) return;  // Shift and the like change nothing
        break;
    }
    all_selected_ = false;
    note_.clear();
  }

  void press(int, int) override {}
  void release(int, int) override {}
  void close_requested() override { finish(1); }
  bool finished() const override { return finished_; }
  const FileDialogResult& result() const { return result_; }

 private:
  void paint_field(DialogWindowX11& w, int text_top, int lh) {
    const guikit::Rect field{kFieldLeft, kFieldTop, kWidth - kMargin, kFieldTop + kFieldHeight};
    w.fill(field, kFieldColour);
    w.frame(field, kFieldEdge);
    const int inner_left = field.left + kFieldInset;
    const int inner_width = field.width() - 2 * kFieldInset;
    // Scrolled by whole characters so that the caret stays in view.
    size_t first = 0;
    while (first < caret_ && w.text_width(text_.substr(first, caret_ - first)) > inner_width - 1) ++first;
    const std::string shown = text_.substr(first);
    const guikit::Rect box{inner_left, text_top, field.right - kFieldInset, text_top + lh};
    if (all_selected_) {
      const int sw = std::min(w.text_width(shown), inner_width);
      w.fill(guikit::Rect{inner_left, text_top, inner_left + sw, text_top + lh}, kSelection);
      w.text(box, shown, kSelectedText);
      return;
    }
    w.text(box, shown, kTextColour);
    const int caret_x = inner_left + w.text_width(text_.substr(first, caret_ - first));
    w.fill(guikit::Rect{caret_x, text_top, caret_x + 1, text_top + lh}, kTextColour);
  }

  void clear() {
    text_.clear();
    caret_ = 0;
  }

  void insert(char c) {
    if (all_selected_) {
      clear();
      all_selected_ = false;
    }
    if (text_.size() >= kMaxPath) return;
    text_.insert(caret_, 1, c);
    ++caret_;
  }

  void submit() {
    if (text_.empty()) {
      finish(1);
      return;
    }
    const std::string path = resolve(text_, request_.directory);
    if (!request_.save && !is_file(path)) {
      // An open dialog answers only with something that can be read: a mistyped
      // name keeps the user here with a note, where the desktop's dialogs would
      // never offer it, instead of ending in the caller's load error.
      note_ = "No such file";
      return;
    }
    if (request_.save && is_folder(path)) {
      note_ = "This is a folder";
      return;
    }
    if (request_.save && !folder_of(path).empty() && !is_folder(folder_of(path))) {
      note_ = "No such folder";
      return;
    }
    result_.path = path;
    finish(0);
  }

  void finish(int32_t status) {
    result_.status = status;
    finished_ = true;
  }

  const FileDialogRequest& request_;
  std::string text_;
  size_t caret_ = 0;
  bool all_selected_ = false;
  std::string note_;
  bool finished_ = false;
  FileDialogResult result_;
};

}  // namespace

FileDialogResult run_fallback_file_dialog(const FileDialogRequest& request) {
  FileDialogResult failed;
  failed.status = -1024;
  failed.filter_index = request.filter_index;
  DialogWindowX11 window;
  if (!window.connect()) return failed;
  const std::string title = !request.title.empty() ? request.title : (request.save ? "Save file" : "Open file");
  if (!window.create(title, guikit::Size{kWidth, kHeight})) return failed;
  FileDialogContent content(request);
  window.run(content);
  return content.result();
}

}  // namespace sys
