#pragma once

#include "host/audio_effect.h"

// The extended glue: the dispatcher opcodes from 25 up and the host-callback
// wrappers of the later interface versions.
class AudioEffectX : public AudioEffect {
 public:
  AudioEffectX(Vst2HostCallback host, int32_t num_programs, int32_t num_params)
      : AudioEffect(host, num_programs, num_params) {}

  intptr_t dispatcher(int32_t opcode, int32_t index, intptr_t value, void* ptr, float opt) override;

  virtual int32_t processEvents(VstEvents* events) { return 0; }
  virtual bool canParameterBeAutomated(int32_t index) { return true; }
  virtual bool string2parameter(int32_t index, const char* text) { return false; }
  virtual int32_t getNumCategories() { return 1; }
  virtual bool getProgramNameIndexed(int32_t category, int32_t index, char* text) { return false; }
  virtual bool copyProgram(int32_t destination) { return false; }
  virtual bool getInputProperties(int32_t index, VstPinProperties* properties) { return false; }
  virtual bool getOutputProperties(int32_t index, VstPinProperties* properties) { return false; }
  virtual int32_t getPlugCategory() { return kPlugCategUnknown; }
  virtual bool setBlockSizeAndSampleRate(int32_t block_size, float sample_rate);
  virtual bool getEffectName(char* name) { return false; }
  virtual bool getVendorString(char* text) { return false; }
  virtual bool getProductString(char* text) { return false; }
  virtual int32_t getVendorVersion() { return 0; }
  virtual int32_t canDo(const char* text) { return 0; }
  virtual bool getParameterProperties(int32_t index, VstParameterProperties* p) { return false; }
  virtual int32_t getVstVersion() { return 2200; }
  virtual int32_t getCurrentMidiProgram() { return -1; }

  // Host-callback wrappers used by the plug-in.
  void wantEvents(int32_t filter = 1) { call_host(audioMasterWantMidi, 0, filter); }
  VstTimeInfo* getTimeInfo(int32_t filter) {
    return reinterpret_cast<VstTimeInfo*>(call_host(audioMasterGetTime, 0, filter));
  }
  bool sendVstEventsToHost(VstEvents* events) { return call_host(audioMasterProcessEvents, 0, 0, events) == 1; }
  int32_t getNumAutomatableParameters() {
    return static_cast<int32_t>(call_host(audioMasterGetNumAutomatableParameters));
  }
  int32_t getParameterQuantization() {
    return static_cast<int32_t>(call_host(audioMasterGetParameterQuantization));
  }
  bool sizeWindow(int32_t width, int32_t height) { return call_host(audioMasterSizeWindow, width, height) != 0; }
  int32_t canHostDo(const char* text) {
    return static_cast<int32_t>(call_host(audioMasterCanDo, 0, 0, const_cast<char*>(text)));
  }
  const char* getDirectory() { return reinterpret_cast<const char*>(call_host(audioMasterGetDirectory)); }
  bool updateDisplay() { return call_host(audioMasterUpdateDisplay) != 0; }
};
