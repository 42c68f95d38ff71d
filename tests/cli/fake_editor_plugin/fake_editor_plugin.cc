// A plug-in with a plain X11 editor, to test the host's editor commands and
// the validator's editor checks without depending on the real editor. One
// parameter "Shade" (0..1) and two programs, "Dim" (0.25) and "Bright"
// (0.75). The editor is 120x80: its red channel is round(Shade * 255), green
// 0x40, blue 0xFF once a block was processed (else 0), with a white 10x10
// square at (5, 5). FAKE_EDITOR_LEAK builds a faulty variant whose
// effEditClose leaves its window in the host's parent.
//
// Kept as .cc so the test glob does not pull it into the test binary.
#include <X11/Xlib.h>
#include <X11/Xutil.h>

#include <atomic>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <new>
#include <thread>

#include "host/vst2_abi.h"

#define FAKE_EDITOR_EXPORT __attribute__((visibility("default")))

namespace {

// Text capacities a host provides, terminator included.
constexpr size_t kProgramNameCapacity = 24;
constexpr size_t kParamTextCapacity = 8;
constexpr size_t kEffectNameCapacity = 32;
constexpr int kWidth = 120;
constexpr int kHeight = 80;
constexpr float kProgramShades[2] = {0.25f, 0.75f};
const char* const kProgramNames[2] = {"Dim", "Bright"};

struct FakeEditor {
  AEffect effect;
  Vst2HostCallback host;
  std::atomic<float> shade{0.25f};
  std::atomic<long> blocks{0};
  int program = 0;
  ERect rect{0, 0, kHeight, kWidth};
  Display* display = nullptr;
  Window window = 0;
};

FakeEditor* self(AEffect* effect) { return static_cast<FakeEditor*>(effect->object); }

void copy_text(void* ptr, const char* text, size_t capacity) {
  char* out = static_cast<char*>(ptr);
  std::strncpy(out, text, capacity - 1);
  out[capacity - 1] = '\0';
}

unsigned long scaled(unsigned value, unsigned long mask) {
  if (mask == 0) return 0;
  int shift = 0;
  while (((mask >> shift) & 1ul) == 0) ++shift;
  const unsigned long top = mask >> shift;
  return ((value * top + 127) / 255) << shift;
}

unsigned long pixel_of(Display* display, unsigned red, unsigned green, unsigned blue) {
  Visual* visual = DefaultVisual(display, DefaultScreen(display));
  return scaled(red, visual->red_mask) | scaled(green, visual->green_mask) |
         scaled(blue, visual->blue_mask);
}

void paint(FakeEditor& fake) {
  const unsigned red = static_cast<unsigned>(std::floor(fake.shade.load() * 255.0f + 0.5f));
  const unsigned blue = fake.blocks.load() > 0 ? 0xFF : 0x00;
  GC gc = XCreateGC(fake.display, fake.window, 0, nullptr);
  XSetForeground(fake.display, gc, pixel_of(fake.display, red, 0x40, blue));
  XFillRectangle(fake.display, fake.window, gc, 0, 0, kWidth, kHeight);
  XSetForeground(fake.display, gc, pixel_of(fake.display, 0xFF, 0xFF, 0xFF));
  XFillRectangle(fake.display, fake.window, gc, 5, 5, 10, 10);
  XFreeGC(fake.display, gc);
  XFlush(fake.display);
}

intptr_t open_editor(FakeEditor& fake, void* parent) {
  if (fake.window != 0 || parent == nullptr) return 0;
  // A busy virtual server may refuse a connection opened right after another one.
  for (int attempt = 0; attempt < 8 && fake.display == nullptr; ++attempt) {
    if (attempt > 0) std::this_thread::sleep_for(std::chrono::milliseconds(10 * attempt));
    fake.display = XOpenDisplay(nullptr);
  }
  if (fake.display == nullptr) return 0;
  const Window parent_window = static_cast<Window>(reinterpret_cast<uintptr_t>(parent));
  fake.window = XCreateSimpleWindow(fake.display, parent_window, 0, 0, kWidth, kHeight, 0, 0, 0);
  XSelectInput(fake.display, fake.window, ExposureMask);
  XMapWindow(fake.display, fake.window);
  XSync(fake.display, False);
  return 1;
}

void idle_editor(FakeEditor& fake) {
  if (fake.window == 0) return;
  while (XPending(fake.display) > 0) {
    XEvent event;
    XNextEvent(fake.display, &event);
  }
  paint(fake);
}

void close_editor(FakeEditor& fake) {
  if (fake.window == 0) return;
#if defined(FAKE_EDITOR_LEAK)
  // The fault: forget the window and its connection, so both stay.
  fake.window = 0;
  fake.display = nullptr;
#else
  XDestroyWindow(fake.display, fake.window);
  XCloseDisplay(fake.display);
  fake.window = 0;
  fake.display = nullptr;
#endif
}

intptr_t VST2_CALL dispatcher(AEffect* effect, int32_t opcode, int32_t index, intptr_t value,
                              void* ptr, float opt) {
  (void)value;
  (void)opt;
  FakeEditor& fake = *self(effect);
  switch (opcode) {
    case effClose:
      close_editor(fake);
      delete &fake;
      return 1;
    case effSetProgram:
      if (value < 0 || value > 1) return 0;
      fake.program = static_cast<int>(value);
      fake.shade.store(kProgramShades[fake.program]);
      return 1;
    case effGetProgram:
      return fake.program;
    case effGetProgramName:
      copy_text(ptr, kProgramNames[fake.program], kProgramNameCapacity);
      return 1;
    case effGetProgramNameIndexed:
      if (index < 0 || index > 1) return 0;
      copy_text(ptr, kProgramNames[index], kProgramNameCapacity);
      return 1;
    case effGetParamName:
      copy_text(ptr, "Shade", kParamTextCapacity);
      return 0;
    case effGetParamDisplay: {
      char text[16];
      std::snprintf(text, sizeof(text), "%.2f", fake.shade.load());
      copy_text(ptr, text, kParamTextCapacity);
      return 0;
    }
    case effString2Parameter: {
      if (ptr == nullptr || index != 0) return 0;
      char* end = nullptr;
      const double shade = std::strtod(static_cast<const char*>(ptr), &end);
      if (end == ptr || *end != '\0' || shade < 0.0 || shade > 1.0) return 0;
      fake.shade.store(static_cast<float>(shade));
      return 1;
    }
    case effEditGetRect:
      if (ptr == nullptr) return 0;
      *static_cast<ERect**>(ptr) = &fake.rect;
      return 1;
    case effEditOpen:
      return open_editor(fake, ptr);
    case effEditIdle:
      idle_editor(fake);
      return 0;
    case effEditClose:
      close_editor(fake);
      return 0;
    case effGetEffectName:
      copy_text(ptr, "FakeEditor", kEffectNameCapacity);
      return 1;
    case effGetVstVersion:
      return 2400;
    default:
      return 0;
  }
}

void VST2_CALL set_parameter(AEffect* effect, int32_t index, float value) {
  if (index == 0) self(effect)->shade.store(value < 0.0f ? 0.0f : value > 1.0f ? 1.0f : value);
}

float VST2_CALL get_parameter(AEffect* effect, int32_t index) {
  return index == 0 ? self(effect)->shade.load() : 0.0f;
}

void VST2_CALL process_replacing(AEffect* effect, float** inputs, float** outputs, int32_t frames) {
  for (int c = 0; c < 2; ++c) {
    for (int32_t i = 0; i < frames; ++i) outputs[c][i] = inputs[c][i];
  }
  self(effect)->blocks.fetch_add(1, std::memory_order_relaxed);
}

void VST2_CALL process_adding(AEffect* effect, float** inputs, float** outputs, int32_t frames) {
  for (int c = 0; c < 2; ++c) {
    for (int32_t i = 0; i < frames; ++i) outputs[c][i] += inputs[c][i];
  }
  self(effect)->blocks.fetch_add(1, std::memory_order_relaxed);
}

}  // namespace

extern "C" FAKE_EDITOR_EXPORT AEffect* VSTPluginMain(Vst2HostCallback host) {
  if (host == nullptr || host(nullptr, audioMasterVersion, 0, 0, nullptr, 0.0f) == 0) return nullptr;
  FakeEditor* fake = new (std::nothrow) FakeEditor();
  if (fake == nullptr) return nullptr;
  fake->host = host;
  AEffect& e = fake->effect;
  std::memset(&e, 0, sizeof(e));
  e.magic = kVstMagic;
  e.dispatcher = dispatcher;
  e.process = process_adding;
  e.setParameter = set_parameter;
  e.getParameter = get_parameter;
  e.numPrograms = 2;
  e.numParams = 1;
  e.numInputs = 2;
  e.numOutputs = 2;
  e.flags = effFlagsHasEditor | effFlagsCanReplacing;
  e.object = fake;
  e.uniqueID = 0x46456474;  // 'FEdt'
  e.version = 1;
  e.processReplacing = process_replacing;
  return &e;
}
