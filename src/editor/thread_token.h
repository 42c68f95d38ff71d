#pragma once

#include <cstdint>

// A number that tells the calling thread apart from every other running thread.
// Cheap enough for the audio thread: no allocation and no system call.
uint64_t current_thread_token();
