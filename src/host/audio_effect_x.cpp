#include "host/audio_effect_x.h"

#include "host/aeff_editor.h"

bool AudioEffectX::setBlockSizeAndSampleRate(int32_t block_size, float sample_rate) {
  block_size_ = block_size;
  sample_rate_ = sample_rate;
  return true;
}

intptr_t AudioEffectX::dispatcher(int32_t opcode, int32_t index, intptr_t value, void* ptr, float opt) {
  char* text = static_cast<char*>(ptr);
  switch (opcode) {
    case effProcessEvents: return ptr != nullptr ? processEvents(static_cast<VstEvents*>(ptr)) : 1;
    case effCanBeAutomated: return canParameterBeAutomated(index) ? 1 : 0;
    case effString2Parameter: return string2parameter(index, text) ? 1 : 0;
    case effGetNumProgramCategories: return getNumCategories();
    case effGetProgramNameIndexed:
      return text != nullptr && getProgramNameIndexed(static_cast<int32_t>(value), index, text) ? 1 : 0;
    case effCopyProgram: return copyProgram(index) ? 1 : 0;
    case effConnectInput:
    case effConnectOutput: return 1;
    case effGetInputProperties:
      return ptr != nullptr && getInputProperties(index, static_cast<VstPinProperties*>(ptr)) ? 1 : 0;
    case effGetOutputProperties:
      return ptr != nullptr && getOutputProperties(index, static_cast<VstPinProperties*>(ptr)) ? 1 : 0;
    case effGetPlugCategory: return getPlugCategory();
    case effSetBlockSizeAndSampleRate:
      return setBlockSizeAndSampleRate(static_cast<int32_t>(value), opt) ? 1 : 0;
    case effGetEffectName: return text != nullptr && getEffectName(text) ? 1 : 0;
    case effGetVendorString: return text != nullptr && getVendorString(text) ? 1 : 0;
    case effGetProductString: return text != nullptr && getProductString(text) ? 1 : 0;
    case effGetVendorVersion: return getVendorVersion();
    case effCanDo: return text != nullptr ? canDo(text) : 0;
    case effGetParameterProperties:
      return ptr != nullptr && getParameterProperties(index, static_cast<VstParameterProperties*>(ptr)) ? 1 : 0;
    case effGetVstVersion: return getVstVersion();
    case effEditKeyDown:
      return editor_ != nullptr ? editor_->onKeyDown(index, static_cast<int32_t>(value), static_cast<int32_t>(opt)) : 0;
    case effEditKeyUp:
      return editor_ != nullptr ? editor_->onKeyUp(index, static_cast<int32_t>(value), static_cast<int32_t>(opt)) : 0;
    case effSetEditKnobMode: return editor_ != nullptr ? editor_->setKnobMode(static_cast<int32_t>(value)) : 0;
    case effGetCurrentMidiProgram: return getCurrentMidiProgram();
    default: break;
  }
  if (opcode < effProcessEvents) {
    return AudioEffect::dispatcher(opcode, index, value, ptr, opt);
  }
  return 0;
}
