#include "editor/thread_token.h"

#include <pthread.h>

// pthread_self reads the thread pointer; it neither allocates nor enters the kernel.
uint64_t current_thread_token() { return static_cast<uint64_t>(pthread_self()); }
