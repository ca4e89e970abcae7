// Preloaded (LD_PRELOAD) by the end-to-end cases that need a moment of a run
// that no input can bring about on its own. Each behaviour is asked for by an
// environment variable and acts on the calls that the program makes through
// the C library:
//
//   ZOR2_TEST_STOP_AT_RENAME=DIR  a rename creates the directory DIR and then
//                                 waits for a signal forever: the run is held
//                                 while its temporary file exists
//   ZOR2_TEST_FIFO_AT_OPEN=PATH   the first open of PATH first replaces the
//                                 file with a named pipe, as if it had been
//                                 swapped after the directory was listed
//   ZOR2_TEST_NO_FD_FOR_ICONV=1   iconv_open runs with every file descriptor
//                                 taken, and they stay taken until the thread
//                                 opens a file: a process at its limit
#define _GNU_SOURCE
#include <dlfcn.h>
#include <fcntl.h>
#include <iconv.h>
#include <pthread.h>
#include <stdarg.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/eventfd.h>
#include <sys/stat.h>
#include <unistd.h>

static void StopIfAsked(void) {
  const char* marker = getenv("ZOR2_TEST_STOP_AT_RENAME");
  if (marker == NULL) return;
  mkdir(marker, 0755);
  for (;;) pause();
}

int rename(const char* from, const char* to) {
  StopIfAsked();
  int (*real)(const char*, const char*) = dlsym(RTLD_NEXT, "rename");
  return real(from, to);
}

int renameat(int from_dir, const char* from, int to_dir, const char* to) {
  StopIfAsked();
  int (*real)(int, const char*, int, const char*) = dlsym(RTLD_NEXT, "renameat");
  return real(from_dir, from, to_dir, to);
}

int renameat2(int from_dir, const char* from, int to_dir, const char* to, unsigned flags) {
  StopIfAsked();
  int (*real)(int, const char*, int, const char*, unsigned) = dlsym(RTLD_NEXT, "renameat2");
  return real(from_dir, from, to_dir, to, flags);
}

// The descriptors taken for iconv_open, and the thread that took them. Its
// next open gives them all back. Until then the process stays at its limit:
// an open on another thread gives back one, which that open then takes, and
// a descriptor closed on another thread is taken again. The lock makes
// iconv_open, eventfd, each open and each close one step.
static int no_fd_for_iconv = -1;
static pthread_mutex_t taken_lock = PTHREAD_MUTEX_INITIALIZER;
static int* taken = NULL;
static size_t taken_count = 0;
static size_t taken_capacity = 0;
static pthread_t taker;

static int NoFdForIconv(void) {
  if (no_fd_for_iconv < 0) no_fd_for_iconv = getenv("ZOR2_TEST_NO_FD_FOR_ICONV") != NULL;
  return no_fd_for_iconv;
}

static void Lock(void) {
  if (NoFdForIconv()) pthread_mutex_lock(&taken_lock);
}

static void Unlock(void) {
  if (NoFdForIconv()) pthread_mutex_unlock(&taken_lock);
}

static int RealClose(int fd) {
  int (*real)(int) = dlsym(RTLD_NEXT, "close");
  return real(fd);
}

// Keeps `fd` among the taken descriptors; called with the lock held.
static void Keep(int fd) {
  if (taken_count == taken_capacity) {
    size_t capacity = taken_capacity * 2 + 64;
    int* larger = realloc(taken, capacity * sizeof *taken);
    if (larger == NULL) {
      RealClose(fd);
      return;
    }
    taken = larger;
    taken_capacity = capacity;
  }
  taken[taken_count++] = fd;
}

// Called with the lock held.
static void TakeDescriptors(void) {
  taker = pthread_self();
  for (int fd; (fd = dup(2)) >= 0;) Keep(fd);
}

// Called with the lock held, before an open.
static void BeforeOpen(const char* path) {
  if (taken_count > 0 && !pthread_equal(taker, pthread_self())) {
    RealClose(taken[--taken_count]);
  } else {
    while (taken_count > 0) RealClose(taken[--taken_count]);
  }
  const char* fifo = getenv("ZOR2_TEST_FIFO_AT_OPEN");
  if (fifo != NULL && path != NULL && strcmp(path, fifo) == 0) {
    unsetenv("ZOR2_TEST_FIFO_AT_OPEN");
    unlink(path);
    mkfifo(path, 0644);
  }
}

static mode_t ModeArgument(va_list arguments) {
  return (mode_t)va_arg(arguments, int);
}

int open(const char* path, int flags, ...) {
  va_list arguments;
  va_start(arguments, flags);
  mode_t mode = ModeArgument(arguments);
  va_end(arguments);
  int (*real)(const char*, int, ...) = dlsym(RTLD_NEXT, "open");
  Lock();
  BeforeOpen(path);
  int fd = real(path, flags, mode);
  Unlock();
  return fd;
}

int open64(const char* path, int flags, ...) {
  va_list arguments;
  va_start(arguments, flags);
  mode_t mode = ModeArgument(arguments);
  va_end(arguments);
  int (*real)(const char*, int, ...) = dlsym(RTLD_NEXT, "open64");
  Lock();
  BeforeOpen(path);
  int fd = real(path, flags, mode);
  Unlock();
  return fd;
}

int openat(int dir, const char* path, int flags, ...) {
  va_list arguments;
  va_start(arguments, flags);
  mode_t mode = ModeArgument(arguments);
  va_end(arguments);
  int (*real)(int, const char*, int, ...) = dlsym(RTLD_NEXT, "openat");
  Lock();
  BeforeOpen(path);
  int fd = real(dir, path, flags, mode);
  Unlock();
  return fd;
}

int openat64(int dir, const char* path, int flags, ...) {
  va_list arguments;
  va_start(arguments, flags);
  mode_t mode = ModeArgument(arguments);
  va_end(arguments);
  int (*real)(int, const char*, int, ...) = dlsym(RTLD_NEXT, "openat64");
  Lock();
  BeforeOpen(path);
  int fd = real(dir, path, flags, mode);
  Unlock();
  return fd;
}

FILE* fopen(const char* path, const char* mode) {
  FILE* (*real)(const char*, const char*) = dlsym(RTLD_NEXT, "fopen");
  Lock();
  BeforeOpen(path);
  FILE* file = real(path, mode);
  Unlock();
  return file;
}

FILE* fopen64(const char* path, const char* mode) {
  FILE* (*real)(const char*, const char*) = dlsym(RTLD_NEXT, "fopen64");
  Lock();
  BeforeOpen(path);
  FILE* file = real(path, mode);
  Unlock();
  return file;
}

int mkostemp(char* pattern, int flags) {
  int (*real)(char*, int) = dlsym(RTLD_NEXT, "mkostemp");
  Lock();
  BeforeOpen(NULL);
  int fd = real(pattern, flags);
  Unlock();
  return fd;
}

int mkstemp(char* pattern) {
  int (*real)(char*) = dlsym(RTLD_NEXT, "mkstemp");
  Lock();
  BeforeOpen(NULL);
  int fd = real(pattern);
  Unlock();
  return fd;
}

int close(int fd) {
  Lock();
  int result = RealClose(fd);
  if (result == 0 && taken_count > 0 && !pthread_equal(taker, pthread_self())) {
    int again = dup(2);
    if (again >= 0) Keep(again);
  }
  Unlock();
  return result;
}

iconv_t iconv_open(const char* to, const char* from) {
  iconv_t (*real)(const char*, const char*) = dlsym(RTLD_NEXT, "iconv_open");
  if (!NoFdForIconv()) return real(to, from);
  Lock();
  TakeDescriptors();
  iconv_t converter = real(to, from);
  Unlock();
  return converter;
}

int eventfd(unsigned initial, int flags) {
  int (*real)(unsigned, int) = dlsym(RTLD_NEXT, "eventfd");
  Lock();
  int fd = real(initial, flags);
  Unlock();
  return fd;
}
