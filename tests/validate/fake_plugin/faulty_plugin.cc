// A small VST 2 effect (gain into a one-pole low-pass, stereo) that behaves
// like a careful plug-in unless VALIDATE_FAKE_FAULT names one fault to
// commit, so the validation battery can be shown to catch each of them.
//
// Faults: accept_versionless, shared_state, unterminated_text, overrun_index,
// loud, sticky_nan, adding_replaces, accept_any_chunk, lossy_chunk,
// allocates, sticky_program, param_out_of_range.
//
// Kept as .cc so the test glob does not pull it into the test binary.
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <new>
#include <string>
#include <vector>

#include "host/vst2_abi.h"

#define FAULTY_EXPORT __attribute__((visibility("default")))

namespace {

constexpr int kNumParams = 3;  // gain, tone, width
constexpr int kNumPrograms = 4;
constexpr uint32_t kChunkMagic = 0x46617574;  // 'Faut'

bool fault(const char* name) {
  const char* chosen = std::getenv("VALIDATE_FAKE_FAULT");
  return chosen != nullptr && std::strcmp(chosen, name) == 0;
}

struct Filter {
  float state[2] = {0.0f, 0.0f};
};
Filter g_shared_filter;  // used only by the shared_state fault

struct Faulty {
  AEffect effect;
  Vst2HostCallback host;
  float values[kNumParams];
  float programs[kNumPrograms][kNumParams];
  int current_program = 0;
  Filter own_filter;
  Filter* filter = &own_filter;
  double rate = 44100.0;
  std::vector<uint8_t> chunk;
  // Faults are read once at creation so a test can set them per instance.
  bool versionless_ok, unterminated, overrun, loud, sticky_nan, adding_replaces, accept_any,
      lossy, allocates, sticky_program, out_of_range;
  int blocks = 0;
};

Faulty* self(AEffect* effect) { return static_cast<Faulty*>(effect->object); }

const char* kNames[kNumParams] = {"Gain", "Tone", "Width"};

void copy_text(void* ptr, const char* text, size_t capacity) {
  char* out = static_cast<char*>(ptr);
  std::strncpy(out, text, capacity - 1);
  out[capacity - 1] = '\0';
}

float gain_of(const Faulty& f) {
  const float gain = static_cast<float>(std::pow(10.0, (-24.0 + 36.0 * f.values[0]) / 20.0));
  return f.loud && f.values[0] > 0.8f ? gain * 1e5f : gain;
}

void apply_program(Faulty& f, int program) {
  f.current_program = program;
  // The sticky fault applies programs only while no audio has run yet.
  if (f.sticky_program && f.blocks > 0) return;
  std::memcpy(f.values, f.programs[program], sizeof(f.values));
}

void write_be32(uint8_t* p, uint32_t v) {
  for (int k = 0; k < 4; ++k) p[k] = static_cast<uint8_t>(v >> (24 - 8 * k));
}
uint32_t read_be32(const uint8_t* p) {
  return (uint32_t{p[0]} << 24) | (uint32_t{p[1]} << 16) | (uint32_t{p[2]} << 8) | p[3];
}

// Chunk: magic, value count, then the values (of the current program, or of
// every program for a bank) as big-endian float bits.
intptr_t get_chunk(Faulty& f, void** out, bool program_only) {
  if (!program_only) std::memcpy(f.programs[f.current_program], f.values, sizeof(f.values));
  const int count = program_only ? kNumParams : kNumParams * kNumPrograms;
  f.chunk.assign(8 + 4 * static_cast<size_t>(count), 0);
  write_be32(f.chunk.data(), kChunkMagic);
  write_be32(f.chunk.data() + 4, static_cast<uint32_t>(count));
  const float* values = program_only ? f.values : &f.programs[0][0];
  for (int i = 0; i < count; ++i) {
    float value = values[i];
    if (f.lossy && i % kNumParams == 1) value = 0.5f;  // the tone is never saved
    uint32_t bits;
    std::memcpy(&bits, &value, 4);
    write_be32(f.chunk.data() + 8 + 4 * i, bits);
  }
  *out = f.chunk.data();
  return static_cast<intptr_t>(f.chunk.size());
}

intptr_t set_chunk(Faulty& f, const uint8_t* p, intptr_t size, bool program_only) {
  const int count = program_only ? kNumParams : kNumParams * kNumPrograms;
  // The accepting fault takes valid chunks properly and says yes to the rest.
  if (p == nullptr || size != 8 + 4 * count || read_be32(p) != kChunkMagic ||
      read_be32(p + 4) != static_cast<uint32_t>(count)) {
    return f.accept_any ? 1 : 0;
  }
  std::vector<float> values(static_cast<size_t>(count));
  for (int i = 0; i < count; ++i) {
    const uint32_t bits = read_be32(p + 8 + 4 * i);
    std::memcpy(&values[static_cast<size_t>(i)], &bits, 4);
    if (!(values[static_cast<size_t>(i)] >= 0.0f && values[static_cast<size_t>(i)] <= 1.0f)) {
      return f.accept_any ? 1 : 0;
    }
  }
  float* target = program_only ? f.programs[f.current_program] : &f.programs[0][0];
  std::memcpy(target, values.data(), sizeof(float) * values.size());
  std::memcpy(f.values, f.programs[f.current_program], sizeof(f.values));
  return 1;
}

void display(const Faulty& f, int index, char* out) {
  if (f.unterminated && index == 1) {
    std::memset(out, 'T', 24);  // fills the host's 24 bytes, no terminator
    return;
  }
  char text[32];
  std::snprintf(text, sizeof(text), "%.3f", static_cast<double>(f.values[index]));
  copy_text(out, text, 24);
}

intptr_t VST2_CALL dispatch(AEffect* effect, int32_t opcode, int32_t index, intptr_t value,
                            void* ptr, float opt) {
  Faulty& f = *self(effect);
  const bool param_ok = index >= 0 && index < kNumParams;
  switch (opcode) {
    case effClose:
      delete &f;
      return 0;
    case effSetProgram:
      if (value >= 0 && value < kNumPrograms) apply_program(f, static_cast<int>(value));
      return 0;
    case effGetProgram:
      return f.current_program;
    case effGetProgramName: {
      char name[16];
      std::snprintf(name, sizeof(name), "Program %d", f.current_program);
      copy_text(ptr, name, 24);
      return 0;
    }
    case effGetParamLabel:
    case effGetParamName:
    case effGetParamDisplay:
      if (f.overrun && index == INT32_MAX) {
        std::memset(ptr, 'O', 40);
        static_cast<char*>(ptr)[40] = '\0';
        return 0;
      }
      if (!param_ok) return 0;
      if (opcode == effGetParamLabel) copy_text(ptr, index == 0 ? "dB" : "", 24);
      if (opcode == effGetParamName) copy_text(ptr, kNames[index], 24);
      if (opcode == effGetParamDisplay) display(f, index, static_cast<char*>(ptr));
      return 0;
    case effSetSampleRate:
      f.rate = opt;
      return 0;
    case effMainsChanged:
      if (value != 0) f.own_filter = Filter{};
      return 0;
    case effGetChunk:
      return get_chunk(f, static_cast<void**>(ptr), index != 0);
    case effSetChunk:
      return set_chunk(f, static_cast<const uint8_t*>(ptr), value, index != 0);
    case effGetProgramNameIndexed:
      if (index < 0 || index >= kNumPrograms) return 0;
      copy_text(ptr, "Indexed", 64);
      return 1;
    case effGetEffectName:
      copy_text(ptr, "Faulty", 32);
      return 1;
    case effGetVendorString:
      copy_text(ptr, "Test Bench", 64);
      return 1;
    case effCanDo:
      return 0;
    case effGetVstVersion:
      return 2400;
    default:
      return 0;
  }
}

void run(Faulty& f, float** inputs, float** outputs, int32_t frames, bool adding) {
  if (f.allocates) {
    volatile char* scratch = new char[64];
    scratch[0] = 1;
    delete[] scratch;
  }
  ++f.blocks;
  const float gain = gain_of(f);
  const float a = 0.05f + 0.9f * f.values[1];
  Filter& filter = *f.filter;
  for (int channel = 0; channel < 2; ++channel) {
    float state = filter.state[channel];
    for (int32_t n = 0; n < frames; ++n) {
      state += a * (inputs[channel][n] - state);
      const float y = gain * state;
      outputs[channel][n] = adding && !f.adding_replaces ? outputs[channel][n] + y : y;
    }
    // A careful filter forgets a state that went non-finite.
    filter.state[channel] = std::isfinite(state) || f.sticky_nan ? state : 0.0f;
  }
}

void VST2_CALL process_replacing(AEffect* e, float** in, float** out, int32_t frames) {
  run(*self(e), in, out, frames, false);
}
void VST2_CALL process_adding(AEffect* e, float** in, float** out, int32_t frames) {
  run(*self(e), in, out, frames, true);
}

void VST2_CALL set_parameter(AEffect* e, int32_t index, float value) {
  if (index >= 0 && index < kNumParams) self(e)->values[index] = value;
}

float VST2_CALL get_parameter(AEffect* e, int32_t index) {
  Faulty& f = *self(e);
  if (index < 0 || index >= kNumParams) return 0.0f;
  return f.out_of_range ? f.values[index] * 36.0f - 24.0f : f.values[index];  // dB, not 0..1
}

}  // namespace

extern "C" FAULTY_EXPORT AEffect* VSTPluginMain(Vst2HostCallback host) {
  const intptr_t version = host(nullptr, audioMasterVersion, 0, 0, nullptr, 0.0f);
  if (version == 0 && !fault("accept_versionless")) return nullptr;
  Faulty* f = new (std::nothrow) Faulty();
  if (f == nullptr) return nullptr;
  f->host = host;
  f->versionless_ok = fault("accept_versionless");
  f->unterminated = fault("unterminated_text");
  f->overrun = fault("overrun_index");
  f->loud = fault("loud");
  f->sticky_nan = fault("sticky_nan");
  f->adding_replaces = fault("adding_replaces");
  f->accept_any = fault("accept_any_chunk");
  f->lossy = fault("lossy_chunk");
  f->allocates = fault("allocates");
  f->sticky_program = fault("sticky_program");
  f->out_of_range = fault("param_out_of_range");
  if (fault("shared_state")) f->filter = &g_shared_filter;
  for (int p = 0; p < kNumPrograms; ++p) {
    f->programs[p][0] = 0.5f + 0.1f * p;
    f->programs[p][1] = 0.2f * p;
    f->programs[p][2] = 1.0f - 0.25f * p;
  }
  std::memcpy(f->values, f->programs[0], sizeof(f->values));
  AEffect& effect = f->effect;
  std::memset(&effect, 0, sizeof(effect));
  effect.magic = kVstMagic;
  effect.dispatcher = dispatch;
  effect.process = process_adding;
  effect.setParameter = set_parameter;
  effect.getParameter = get_parameter;
  effect.numPrograms = kNumPrograms;
  effect.numParams = kNumParams;
  effect.numInputs = 2;
  effect.numOutputs = 2;
  effect.flags = effFlagsCanReplacing | effFlagsProgramChunks;
  effect.ioRatio = 1.0f;
  effect.object = f;
  effect.uniqueID = ('F' << 24) | ('a' << 16) | ('u' << 8) | 't';
  effect.version = 1;
  effect.processReplacing = process_replacing;
  return &effect;
}
