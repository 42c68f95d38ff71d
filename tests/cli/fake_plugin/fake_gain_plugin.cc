// A small VST 2 gain used to test the command-line host: two parameters
// (Gain -24..+12 dB, Phase Invert), three programs, bank chunks in the preset
// bank block layout, and honest answers about the pins the host connected.
// It writes what the host did to the file named by FAKE_GAIN_LOG, one event a
// line; FAKE_GAIN_FAULT=null or =bad_magic makes the entry misbehave.
//
// Kept as .cc so the test glob does not pull it into the test binary.
#include <cctype>
#include <cstdarg>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <new>
#include <string>
#include <vector>

#include "host/vst2_abi.h"

#if defined(_WIN32)
#define FAKE_GAIN_EXPORT __declspec(dllexport)
#else
#define FAKE_GAIN_EXPORT __attribute__((visibility("default")))
#endif

namespace {

constexpr int kNumParams = 2;
constexpr int kNumPrograms = 3;
constexpr double kMinDb = -24.0;
constexpr double kMaxDb = 12.0;

struct Program {
  std::string name;
  float values[kNumParams];
};

double norm_to_db(float norm) { return kMinDb + (kMaxDb - kMinDb) * norm; }
float db_to_norm(double db) { return static_cast<float>((db - kMinDb) / (kMaxDb - kMinDb)); }

void copy_text(void* ptr, const std::string& text, size_t capacity) {
  char* out = static_cast<char*>(ptr);
  std::strncpy(out, text.c_str(), capacity - 1);
  out[capacity - 1] = '\0';
}

uint32_t read_be32(const uint8_t* p) {
  return (uint32_t{p[0]} << 24) | (uint32_t{p[1]} << 16) | (uint32_t{p[2]} << 8) | p[3];
}
uint16_t read_be16(const uint8_t* p) { return static_cast<uint16_t>((p[0] << 8) | p[1]); }
void write_be32(uint8_t* p, uint32_t v) {
  for (int k = 0; k < 4; ++k) p[k] = static_cast<uint8_t>(v >> (24 - 8 * k));
}

struct FakeGain {
  AEffect effect;
  Vst2HostCallback host;
  FILE* log = nullptr;
  float values[kNumParams] = {0.0f, 0.0f};
  Program programs[kNumPrograms];
  int current_program = 0;
  bool resumed = false;
  bool input1_connected = true;
  bool output1_connected = true;
  long replacing_calls = 0;
  long adding_calls = 0;
  long frames = 0;
  bool time_logged = false;
  bool suspended_process_logged = false;
  std::vector<uint8_t> chunk;

  void note(const char* format, ...) __attribute__((format(printf, 2, 3)));
  intptr_t ask_host(int32_t opcode, int32_t index = 0, intptr_t value = 0, void* ptr = nullptr) {
    return host(&effect, opcode, index, value, ptr, 0.0f);
  }
};

void FakeGain::note(const char* format, ...) {
  if (log == nullptr) return;
  va_list args;
  va_start(args, format);
  std::vfprintf(log, format, args);
  va_end(args);
  std::fputc('\n', log);
  std::fflush(log);
}

FakeGain* self(AEffect* effect) { return static_cast<FakeGain*>(effect->object); }

const char* kParamNames[kNumParams] = {"Gain", "Phase Invert"};

std::string display(const FakeGain& fake, int index) {
  char text[32];
  if (index == 0) {
    std::snprintf(text, sizeof(text), "%.2f", norm_to_db(fake.values[0]));
  } else {
    std::snprintf(text, sizeof(text), "%s", fake.values[1] >= 0.5f ? "On" : "Off");
  }
  return text;
}

bool equals_ignoring_case(const char* a, const char* b) {
  while (*a != '\0' && *b != '\0') {
    if (std::tolower(static_cast<unsigned char>(*a)) != std::tolower(static_cast<unsigned char>(*b)))
      return false;
    ++a, ++b;
  }
  return *a == *b;
}

bool string_to_param(FakeGain& fake, int index, const char* text) {
  if (index == 0) {
    char* end = nullptr;
    const double db = std::strtod(text, &end);
    if (end == text || *end != '\0' || db < kMinDb || db > kMaxDb) return false;
    fake.values[0] = db_to_norm(db);
    return true;
  }
  if (equals_ignoring_case(text, "on")) {
    fake.values[1] = 1.0f;
    return true;
  }
  if (equals_ignoring_case(text, "off")) {
    fake.values[1] = 0.0f;
    return true;
  }
  return false;
}

void set_program(FakeGain& fake, int index) {
  fake.current_program = index;
  for (int i = 0; i < kNumParams; ++i) fake.values[i] = fake.programs[index].values[i];
}

// Bank block: count, record size, then records of tag, name field size, value
// count, extra length, name field, big-endian float values, extra bytes.
intptr_t get_chunk(FakeGain& fake, void** out) {
  const uint32_t record = 12 + 64 + 4 * kNumParams;
  fake.chunk.assign(8 + kNumPrograms * record, 0);
  uint8_t* p = fake.chunk.data();
  write_be32(p, kNumPrograms);
  write_be32(p + 4, record);
  for (int i = 0; i < kNumPrograms; ++i) {
    uint8_t* r = p + 8 + i * record;
    r[4] = 0, r[5] = 64, r[6] = 0, r[7] = kNumParams;
    std::strncpy(reinterpret_cast<char*>(r + 12), fake.programs[i].name.c_str(), 63);
    for (int v = 0; v < kNumParams; ++v) {
      uint32_t bits;
      std::memcpy(&bits, &fake.programs[i].values[v], 4);
      write_be32(r + 76 + 4 * v, bits);
    }
  }
  *out = fake.chunk.data();
  return static_cast<intptr_t>(fake.chunk.size());
}

intptr_t set_chunk(FakeGain& fake, const uint8_t* p, intptr_t size) {
  if (p == nullptr || size < 8) return 0;
  const uint32_t count = read_be32(p);
  const uint32_t record = read_be32(p + 4);
  if (count != kNumPrograms || 8 + uint64_t{count} * record > static_cast<uint64_t>(size)) return 0;
  Program loaded[kNumPrograms];
  for (uint32_t i = 0; i < count; ++i) {
    const uint8_t* r = p + 8 + i * record;
    if (record < 12) return 0;
    const uint32_t name_size = read_be16(r + 4);
    const uint32_t value_count = read_be16(r + 6);
    const uint32_t extra = read_be32(r + 8);
    if (name_size == 0 || value_count < kNumParams ||
        12 + uint64_t{name_size} + 4 * uint64_t{value_count} + extra > record) {
      return 0;
    }
    const char* name = reinterpret_cast<const char*>(r + 12);
    loaded[i].name.assign(name, strnlen(name, name_size));
    for (int v = 0; v < kNumParams; ++v) {
      const uint32_t bits = read_be32(r + 12 + name_size + 4 * v);
      float value;
      std::memcpy(&value, &bits, 4);
      if (!(value >= 0.0f && value <= 1.0f)) return 0;
      loaded[i].values[v] = value;
    }
  }
  for (int i = 0; i < kNumPrograms; ++i) fake.programs[i] = loaded[i];
  set_program(fake, fake.current_program);
  return 1;
}

void resume(FakeGain& fake) {
  const intptr_t rate = fake.ask_host(audioMasterGetSampleRate);
  const intptr_t block = fake.ask_host(audioMasterGetBlockSize);
  const intptr_t automatable = fake.ask_host(audioMasterGetNumAutomatableParameters);
  const intptr_t in0 = fake.ask_host(audioMasterPinConnected, 0, 0);
  const intptr_t in1 = fake.ask_host(audioMasterPinConnected, 1, 0);
  const intptr_t out0 = fake.ask_host(audioMasterPinConnected, 0, 1);
  const intptr_t out1 = fake.ask_host(audioMasterPinConnected, 1, 1);
  char time_cap[] = "sendVstTimeInfo";
  char unknown_cap[] = "fakeGainWonders";
  const intptr_t can_time = fake.ask_host(audioMasterCanDo, 0, 0, time_cap);
  const intptr_t can_unknown = fake.ask_host(audioMasterCanDo, 0, 0, unknown_cap);
  const intptr_t unknown_opcode = fake.ask_host(audioMasterGetLanguage);
  fake.input1_connected = in1 == 0;
  fake.output1_connected = out1 == 0;
  fake.note("resume rate=%ld block=%ld automatable=%ld pins_in=%ld,%ld pins_out=%ld,%ld "
            "cando_time=%ld cando_unknown=%ld other_opcode=%ld",
            static_cast<long>(rate), static_cast<long>(block), static_cast<long>(automatable),
            static_cast<long>(in0), static_cast<long>(in1), static_cast<long>(out0),
            static_cast<long>(out1), static_cast<long>(can_time), static_cast<long>(can_unknown),
            static_cast<long>(unknown_opcode));
  fake.resumed = true;
}

intptr_t VST2_CALL dispatch(AEffect* effect, int32_t opcode, int32_t index, intptr_t value,
                            void* ptr, float opt) {
  FakeGain& fake = *self(effect);
  switch (opcode) {
    case effOpen:
      fake.note("open");
      return 0;
    case effClose:
      fake.note("close replacing=%ld adding=%ld frames=%ld", fake.replacing_calls,
                fake.adding_calls, fake.frames);
      if (fake.log != nullptr) std::fclose(fake.log);
      delete &fake;
      return 0;
    case effSetProgram:
      if (value >= 0 && value < kNumPrograms) set_program(fake, static_cast<int>(value));
      fake.note("program %ld", static_cast<long>(value));
      return 0;
    case effGetProgram:
      return fake.current_program;
    case effGetProgramName:
      copy_text(ptr, fake.programs[fake.current_program].name, 24);
      return 0;
    case effGetParamLabel:
      if (index >= 0 && index < kNumParams) copy_text(ptr, index == 0 ? "dB" : "", 24);
      return 0;
    case effGetParamDisplay:
      if (index >= 0 && index < kNumParams) copy_text(ptr, display(fake, index), 24);
      return 0;
    case effGetParamName:
      if (index >= 0 && index < kNumParams) copy_text(ptr, kParamNames[index], 24);
      return 0;
    case effSetSampleRate:
      fake.note("sample_rate %.0f", static_cast<double>(opt));
      return 0;
    case effSetBlockSize:
      fake.note("block_size %ld", static_cast<long>(value));
      return 0;
    case effMainsChanged:
      fake.note("mains %ld", static_cast<long>(value));
      if (value != 0) {
        resume(fake);
      } else {
        fake.resumed = false;
      }
      return 0;
    case effGetChunk:
      return index == 0 ? get_chunk(fake, static_cast<void**>(ptr)) : 0;
    case effSetChunk: {
      const intptr_t accepted = index == 0 ? set_chunk(fake, static_cast<uint8_t*>(ptr), value) : 0;
      fake.note("set_chunk size=%ld accepted=%ld", static_cast<long>(value),
                static_cast<long>(accepted));
      return accepted;
    }
    case effCanBeAutomated:
      return index == 0 ? 1 : 0;
    case effString2Parameter:
      if (ptr == nullptr) return 1;
      if (index < 0 || index >= kNumParams) return 0;
      return string_to_param(fake, index, static_cast<const char*>(ptr)) ? 1 : 0;
    case effGetProgramNameIndexed:
      if (index < 0 || index >= kNumPrograms) return 0;
      copy_text(ptr, fake.programs[index].name, 64);
      return 1;
    case effGetInputProperties:
    case effGetOutputProperties: {
      if (index < 0 || index > 1) return 0;
      auto* properties = static_cast<VstPinProperties*>(ptr);
      const bool input = opcode == effGetInputProperties;
      copy_text(properties->label,
                std::string(input ? "Fake In " : "Fake Out ") + (index == 0 ? "L" : "R"), 64);
      properties->flags = kVstPinIsActive | kVstPinIsStereo;
      return 1;
    }
    case effGetEffectName:
      copy_text(ptr, "Fake Gain", 32);
      return 1;
    case effGetVendorString:
      copy_text(ptr, "Test Bench", 64);
      return 1;
    case effGetProductString:
      copy_text(ptr, "Fake Gain Module", 64);
      return 1;
    case effGetParameterProperties: {
      if (index < 0 || index >= kNumParams) return 0;
      auto* properties = static_cast<VstParameterProperties*>(ptr);
      copy_text(properties->label, kParamNames[index], 64);
      properties->flags = index == 0 ? kVstParameterCanRamp : kVstParameterIsSwitch;
      return 1;
    }
    case effGetVstVersion:
      return 2400;
    default:
      return 0;
  }
}

void process_block(FakeGain& fake, float** inputs, float** outputs, int32_t frames, bool adding) {
  if (!fake.resumed && !fake.suspended_process_logged) {
    fake.note("error process while suspended");
    fake.suspended_process_logged = true;
  }
  if (!fake.time_logged) {
    const auto* info = reinterpret_cast<const VstTimeInfo*>(
        fake.ask_host(audioMasterGetTime, 0, kVstTempoValid | kVstPpqPosValid));
    if (info == nullptr) {
      fake.note("time none");
    } else {
      fake.note("time tempo=%.3f tempo_valid=%d ppq_valid=%d rate=%.0f", info->tempo,
                (info->flags & kVstTempoValid) != 0, (info->flags & kVstPpqPosValid) != 0,
                info->sampleRate);
    }
    fake.time_logged = true;
  }
  const float gain = static_cast<float>(std::pow(10.0, norm_to_db(fake.values[0]) / 20.0)) *
                     (fake.values[1] >= 0.5f ? -1.0f : 1.0f);
  const float* left = inputs[0];
  const float* right = fake.input1_connected ? inputs[1] : inputs[0];
  for (int32_t n = 0; n < frames; ++n) {
    if (fake.output1_connected) {
      const float l = gain * left[n];
      const float r = gain * right[n];
      outputs[0][n] = adding ? outputs[0][n] + l : l;
      outputs[1][n] = adding ? outputs[1][n] + r : r;
    } else {
      const float m = gain * 0.5f * (left[n] + right[n]);
      outputs[0][n] = adding ? outputs[0][n] + m : m;
    }
  }
  fake.frames += frames;
}

void VST2_CALL process_adding(AEffect* effect, float** inputs, float** outputs, int32_t frames) {
  ++self(effect)->adding_calls;
  process_block(*self(effect), inputs, outputs, frames, true);
}

void VST2_CALL process_replacing(AEffect* effect, float** inputs, float** outputs,
                                 int32_t frames) {
  ++self(effect)->replacing_calls;
  process_block(*self(effect), inputs, outputs, frames, false);
}

void VST2_CALL set_parameter(AEffect* effect, int32_t index, float value) {
  if (index >= 0 && index < kNumParams) self(effect)->values[index] = value;
}

float VST2_CALL get_parameter(AEffect* effect, int32_t index) {
  return index >= 0 && index < kNumParams ? self(effect)->values[index] : 0.0f;
}

AEffect* create(Vst2HostCallback host) {
  const char* fault = std::getenv("FAKE_GAIN_FAULT");
  if (fault != nullptr && std::strcmp(fault, "null") == 0) return nullptr;
  FakeGain* fake = new (std::nothrow) FakeGain();
  if (fake == nullptr) return nullptr;
  fake->host = host;
  const char* log_path = std::getenv("FAKE_GAIN_LOG");
  if (log_path != nullptr) fake->log = std::fopen(log_path, "a");
  fake->note("entry version=%ld", static_cast<long>(host(nullptr, audioMasterVersion, 0, 0, nullptr, 0.0f)));
  fake->programs[0] = Program{"Unity", {db_to_norm(0.0), 0.0f}};
  fake->programs[1] = Program{"Quiet", {db_to_norm(-12.0), 0.0f}};
  fake->programs[2] = Program{"Loud \"Flip\" \\ Six", {db_to_norm(6.0), 1.0f}};
  set_program(*fake, 0);
  AEffect& effect = fake->effect;
  std::memset(&effect, 0, sizeof(effect));
  effect.magic = (fault != nullptr && std::strcmp(fault, "bad_magic") == 0) ? 0x12345678 : kVstMagic;
  effect.dispatcher = dispatch;
  effect.process = process_adding;
  effect.setParameter = set_parameter;
  effect.getParameter = get_parameter;
  effect.numPrograms = kNumPrograms;
  effect.numParams = kNumParams;
  effect.numInputs = 2;
  effect.numOutputs = 2;
  effect.flags = effFlagsCanReplacing | effFlagsCanMono | effFlagsProgramChunks;
  effect.ioRatio = 1.0f;
  effect.object = fake;
  effect.uniqueID = ('F' << 24) | ('k' << 16) | ('G' << 8) | 'n';
  effect.version = 1003;
  effect.processReplacing = process_replacing;
  return &effect;
}

}  // namespace

#if defined(FAKE_GAIN_MAIN_ONLY)
// Only the old entry name, exported under the symbol "main".
extern "C" FAKE_GAIN_EXPORT AEffect* fake_gain_legacy_entry(
    Vst2HostCallback host) __asm__("main");
extern "C" AEffect* fake_gain_legacy_entry(Vst2HostCallback host) { return create(host); }
#else
extern "C" FAKE_GAIN_EXPORT AEffect* VSTPluginMain(Vst2HostCallback host) {
  return create(host);
}
#endif
