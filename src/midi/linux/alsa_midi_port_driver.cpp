// System MIDI on Linux: the ALSA sequencer. Each instance is one sequencer
// client with one input and one output port of its own; selecting a system
// port connects it to ours. Without a sequencer device the driver lists no
// ports and the plug-in runs on the host's MIDI alone.
#include <alsa/asoundlib.h>
#include <poll.h>
#include <unistd.h>

#include <atomic>
#include <thread>
#include <utility>
#include <vector>

#include "midi/midi_port_driver_interface.h"

namespace sys {

namespace {

constexpr const char* kSequencerDevice = "/dev/snd/seq";

int short_message_length(unsigned status) {
  if (status >= 0xF0) return status == 0xF2 ? 3 : (status == 0xF1 || status == 0xF3) ? 2 : 1;
  return (status & 0xF0) == 0xC0 || (status & 0xF0) == 0xD0 ? 2 : 3;
}

class AlsaMidiPortDriver : public MidiPortDriverInterface {
 public:
  AlsaMidiPortDriver() {
    // Checked first so that a machine without the device stays quiet.
    if (::access(kSequencerDevice, R_OK | W_OK) != 0 ||
        snd_seq_open(&seq_, "default", SND_SEQ_OPEN_DUPLEX, SND_SEQ_NONBLOCK) < 0) {
      seq_ = nullptr;
      return;
    }
    snd_seq_set_client_name(seq_, "Brakmorph");
    in_port_ = snd_seq_create_simple_port(seq_, "Brakmorph MIDI In", SND_SEQ_PORT_CAP_WRITE | SND_SEQ_PORT_CAP_SUBS_WRITE,
                                          SND_SEQ_PORT_TYPE_MIDI_GENERIC | SND_SEQ_PORT_TYPE_APPLICATION);
    out_port_ = snd_seq_create_simple_port(seq_, "Brakmorph MIDI Out", SND_SEQ_PORT_CAP_READ | SND_SEQ_PORT_CAP_SUBS_READ,
                                           SND_SEQ_PORT_TYPE_MIDI_GENERIC | SND_SEQ_PORT_TYPE_APPLICATION);
    if (in_port_ < 0 || out_port_ < 0 || snd_midi_event_new(16, &decoder_) < 0 ||
        snd_midi_event_new(16, &encoder_) < 0) {
      release();
      return;
    }
    snd_midi_event_no_status(decoder_, 1);  // every message with its own status byte
  }

  ~AlsaMidiPortDriver() override {
    close_input();
    close_output();
    release();
  }

  int list_inputs(std::vector<std::string>& names) override {
    return list(SND_SEQ_PORT_CAP_READ | SND_SEQ_PORT_CAP_SUBS_READ, names, inputs_);
  }
  int list_outputs(std::vector<std::string>& names) override {
    return list(SND_SEQ_PORT_CAP_WRITE | SND_SEQ_PORT_CAP_SUBS_WRITE, names, outputs_);
  }

  int open_input(int port, MidiInputSinkInterface* sink) override {
    if (seq_ == nullptr || port < 0 || port >= static_cast<int>(inputs_.size()) || reader_.joinable()) return -1;
    const auto& address = inputs_[static_cast<size_t>(port)];
    if (snd_seq_connect_from(seq_, in_port_, address.first, address.second) < 0) return -1;
    input_address_ = address;
    stop_.store(false);
    reader_ = std::thread([this, sink] { read_loop(sink); });
    return 0;
  }

  int close_input() override {
    if (!reader_.joinable()) return 0;
    stop_.store(true);
    reader_.join();
    snd_seq_disconnect_from(seq_, in_port_, input_address_.first, input_address_.second);
    return 0;
  }

  int open_output(int port) override {
    if (seq_ == nullptr || port < 0 || port >= static_cast<int>(outputs_.size()) || output_open_) return -1;
    const auto& address = outputs_[static_cast<size_t>(port)];
    if (snd_seq_connect_to(seq_, out_port_, address.first, address.second) < 0) return -1;
    output_address_ = address;
    output_open_ = true;
    return 0;
  }

  int send_short(uint32_t message) override {
    if (!output_open_) return -1;
    unsigned char bytes[3] = {static_cast<unsigned char>(message & 0xFF), static_cast<unsigned char>((message >> 8) & 0xFF),
                              static_cast<unsigned char>((message >> 16) & 0xFF)};
    snd_seq_event_t event;
    snd_seq_ev_clear(&event);
    snd_midi_event_reset_encode(encoder_);
    if (snd_midi_event_encode(encoder_, bytes, short_message_length(bytes[0]), &event) <= 0 ||
        event.type == SND_SEQ_EVENT_NONE) {
      return -1;
    }
    snd_seq_ev_set_source(&event, out_port_);
    snd_seq_ev_set_subs(&event);
    snd_seq_ev_set_direct(&event);
    return snd_seq_event_output_direct(seq_, &event) >= 0 ? 0 : -1;
  }

  int close_output() override {
    if (!output_open_) return 0;
    output_open_ = false;
    snd_seq_disconnect_to(seq_, out_port_, output_address_.first, output_address_.second);
    return 0;
  }

 private:
  using Address = std::pair<int, int>;

  void release() {
    if (decoder_ != nullptr) snd_midi_event_free(decoder_);
    if (encoder_ != nullptr) snd_midi_event_free(encoder_);
    decoder_ = encoder_ = nullptr;
    if (seq_ != nullptr) snd_seq_close(seq_);
    seq_ = nullptr;
  }

  // Ports of other clients with the given abilities, named "client:port".
  int list(unsigned caps, std::vector<std::string>& names, std::vector<Address>& addresses) {
    addresses.clear();
    if (seq_ == nullptr) return 0;
    const int self = snd_seq_client_id(seq_);
    snd_seq_client_info_t* client;
    snd_seq_port_info_t* port;
    snd_seq_client_info_alloca(&client);
    snd_seq_port_info_alloca(&port);
    snd_seq_client_info_set_client(client, -1);
    while (snd_seq_query_next_client(seq_, client) >= 0) {
      const int id = snd_seq_client_info_get_client(client);
      if (id == self || id == SND_SEQ_CLIENT_SYSTEM) continue;
      snd_seq_port_info_set_client(port, id);
      snd_seq_port_info_set_port(port, -1);
      while (snd_seq_query_next_port(seq_, port) >= 0) {
        if ((snd_seq_port_info_get_capability(port) & caps) != caps) continue;
        addresses.emplace_back(id, snd_seq_port_info_get_port(port));
        names.push_back(std::string(snd_seq_client_info_get_name(client)) + ":" + snd_seq_port_info_get_name(port));
      }
    }
    return 0;
  }

  void read_loop(MidiInputSinkInterface* sink) {
    const int count = snd_seq_poll_descriptors_count(seq_, POLLIN);
    std::vector<pollfd> fds(static_cast<size_t>(count > 0 ? count : 1));
    snd_seq_poll_descriptors(seq_, fds.data(), static_cast<unsigned>(fds.size()), POLLIN);
    while (!stop_.load()) {
      if (::poll(fds.data(), fds.size(), 50) <= 0) continue;
      snd_seq_event_t* event = nullptr;
      while (snd_seq_event_input(seq_, &event) >= 0 && event != nullptr) {
        if (event->dest.port != in_port_) continue;
        unsigned char bytes[16];
        snd_midi_event_reset_decode(decoder_);
        const long length = snd_midi_event_decode(decoder_, bytes, sizeof(bytes), event);
        if (length >= 1 && length <= 3 && bytes[0] >= 0x80 && bytes[0] < 0xF0) {
          const uint32_t message = bytes[0] | (length > 1 ? bytes[1] << 8 : 0) | (length > 2 ? bytes[2] << 16 : 0);
          sink->on_midi_short(message, event->time.tick);
        }
      }
    }
  }

  snd_seq_t* seq_ = nullptr;
  snd_midi_event_t* decoder_ = nullptr;
  snd_midi_event_t* encoder_ = nullptr;
  int in_port_ = -1;
  int out_port_ = -1;
  std::vector<Address> inputs_;
  std::vector<Address> outputs_;
  Address input_address_{-1, -1};
  Address output_address_{-1, -1};
  bool output_open_ = false;
  std::thread reader_;
  std::atomic<bool> stop_{false};
};

}  // namespace

std::unique_ptr<MidiPortDriverInterface> make_system_midi_driver() { return std::make_unique<AlsaMidiPortDriver>(); }

}  // namespace sys
