#include "editor/thread_token.h"

#include <windows.h>

// The id lives in the thread's environment block: reading it costs no system call.
uint64_t current_thread_token() { return static_cast<uint64_t>(GetCurrentThreadId()); }
