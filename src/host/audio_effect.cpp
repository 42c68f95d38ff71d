#include "host/audio_effect.h"

#include <cstring>

#include "host/aeff_editor.h"

namespace {

AudioEffect* object_of(AEffect* e) { return static_cast<AudioEffect*>(e->object); }

intptr_t VST2_CALL dispatch_entry(AEffect* e, int32_t opcode, int32_t index, intptr_t value, void* ptr,
                                  float opt) {
  AudioEffect* object = object_of(e);
  if (opcode == effClose) {
    // The host deletes the instance through effClose; nothing may touch it afterwards.
    object->dispatcher(opcode, index, value, ptr, opt);
    delete object;
    return 0;
  }
  return object->dispatcher(opcode, index, value, ptr, opt);
}

void VST2_CALL process_entry(AEffect* e, float** inputs, float** outputs, int32_t frames) {
  object_of(e)->process(inputs, outputs, frames);
}

void VST2_CALL process_replacing_entry(AEffect* e, float** inputs, float** outputs, int32_t frames) {
  object_of(e)->processReplacing(inputs, outputs, frames);
}

void VST2_CALL set_parameter_entry(AEffect* e, int32_t index, float value) {
  object_of(e)->setParameter(index, value);
}

float VST2_CALL get_parameter_entry(AEffect* e, int32_t index) { return object_of(e)->getParameter(index); }

}  // namespace

AudioEffect::AudioEffect(Vst2HostCallback host, int32_t num_programs, int32_t num_params)
    : host_(host), num_programs_(num_programs), num_params_(num_params) {
  std::memset(&effect_, 0, sizeof(effect_));
  effect_.magic = kVstMagic;
  effect_.dispatcher = dispatch_entry;
  effect_.process = process_entry;
  effect_.setParameter = set_parameter_entry;
  effect_.getParameter = get_parameter_entry;
  effect_.numPrograms = num_programs;
  effect_.numParams = num_params;
  effect_.numInputs = 1;
  effect_.numOutputs = 2;
  effect_.ioRatio = 1.0f;
  effect_.object = this;
  effect_.uniqueID = 0x4E6F4566;  // 'NoEf' until the plug-in sets its own
  effect_.version = 1;
  effect_.processReplacing = process_replacing_entry;
}

AudioEffect::~AudioEffect() { delete editor_; }

void AudioEffect::setEditor(AEffEditor* editor) {
  editor_ = editor;
  set_flag(effFlagsHasEditor, editor != nullptr);
}

void AudioEffect::set_flag(int32_t flag, bool on) {
  if (on) {
    effect_.flags |= flag;
  } else {
    effect_.flags &= ~flag;
  }
}

intptr_t AudioEffect::call_host(int32_t opcode, int32_t index, intptr_t value, void* ptr, float opt) const {
  if (host_ == nullptr) {
    return 0;
  }
  return host_(const_cast<AEffect*>(&effect_), opcode, index, value, ptr, opt);
}

void AudioEffect::setParameterAutomated(int32_t index, float value) {
  setParameter(index, value);
  call_host(audioMasterAutomate, index, 0, nullptr, value);
}

// The host answers 0 for a connected pin; without a host every pin counts as connected.
bool AudioEffect::isInputConnected(int32_t pin) { return call_host(audioMasterPinConnected, pin, 0) == 0; }

bool AudioEffect::isOutputConnected(int32_t pin) { return call_host(audioMasterPinConnected, pin, 1) == 0; }

intptr_t AudioEffect::dispatcher(int32_t opcode, int32_t index, intptr_t value, void* ptr, float opt) {
  char* text = static_cast<char*>(ptr);
  switch (opcode) {
    case effOpen: open(); return 0;
    case effClose: close(); return 0;
    case effSetProgram:
      if (value >= 0 && value < num_programs_) {
        setProgram(static_cast<int32_t>(value));
      }
      return 0;
    case effGetProgram: return getProgram();
    case effSetProgramName:
      if (text != nullptr) {
        setProgramName(text);
      }
      return 0;
    case effGetProgramName:
      if (text != nullptr) {
        getProgramName(text);
      }
      return 0;
    case effGetParamLabel:
      if (text != nullptr) {
        getParameterLabel(index, text);
      }
      return 0;
    case effGetParamDisplay:
      if (text != nullptr) {
        getParameterDisplay(index, text);
      }
      return 0;
    case effGetParamName:
      if (text != nullptr) {
        getParameterName(index, text);
      }
      return 0;
    case effSetSampleRate: setSampleRate(opt); return 0;
    case effSetBlockSize: setBlockSize(static_cast<int32_t>(value)); return 0;
    case effMainsChanged:
      if (value == 0) {
        suspend();
      } else {
        resume();
      }
      return 0;
    case effEditGetRect:
      if (editor_ != nullptr && ptr != nullptr) {
        return editor_->getRect(static_cast<ERect**>(ptr)) ? 1 : 0;
      }
      return 0;
    case effEditOpen: return editor_ != nullptr ? (editor_->open(ptr) ? 1 : 0) : 0;
    case effEditClose:
      if (editor_ != nullptr) {
        editor_->close();
      }
      return 0;
    case effEditIdle:
      if (editor_ != nullptr) {
        editor_->idle();
      }
      return 0;
    case effIdentify: return 0x4E764566;  // 'NvEf'
    case effGetChunk: return ptr != nullptr ? getChunk(static_cast<void**>(ptr), index != 0) : 0;
    case effSetChunk:
      return ptr != nullptr ? setChunk(ptr, static_cast<int32_t>(value), index != 0) : 0;
    default: return 0;
  }
}
