// Preloaded (LD_PRELOAD) by the end-to-end cases that need an allocation to
// fail at a moment no input brings about on its own, as in a process near its
// memory limit: with ZOR2_TEST_NO_MEMORY_ABOVE=N, an allocation of more than
// N bytes fails. It replaces the C library's allocation functions, which the
// program's own allocations (operator new included) go through, so it cannot
// be used with the sanitizers, which replace them too.
#define _GNU_SOURCE
#include <errno.h>
#include <stdlib.h>

extern void* __libc_malloc(size_t size);
extern void* __libc_calloc(size_t count, size_t size);
extern void* __libc_realloc(void* block, size_t size);
extern void* __libc_memalign(size_t alignment, size_t size);

// Neither getenv nor strtoull allocates.
static int TooLarge(size_t size) {
  static size_t limit = 0;
  static int read = 0;
  if (!read) {
    const char* text = getenv("ZOR2_TEST_NO_MEMORY_ABOVE");
    limit = text != NULL ? (size_t)strtoull(text, NULL, 10) : 0;
    read = 1;
  }
  if (limit == 0 || size <= limit) return 0;
  errno = ENOMEM;
  return 1;
}

void* malloc(size_t size) {
  return TooLarge(size) ? NULL : __libc_malloc(size);
}

void* calloc(size_t count, size_t size) {
  return count != 0 && TooLarge(count * size) ? NULL : __libc_calloc(count, size);
}

void* realloc(void* block, size_t size) {
  return TooLarge(size) ? NULL : __libc_realloc(block, size);
}

void* aligned_alloc(size_t alignment, size_t size) {
  return TooLarge(size) ? NULL : __libc_memalign(alignment, size);
}

void* memalign(size_t alignment, size_t size) {
  return TooLarge(size) ? NULL : __libc_memalign(alignment, size);
}

int posix_memalign(void** block, size_t alignment, size_t size) {
  if (TooLarge(size)) return ENOMEM;
  void* allocated = __libc_memalign(alignment, size);
  if (allocated == NULL) return ENOMEM;
  *block = allocated;
  return 0;
}
