/* Preloaded into the tool. Counts the allocations from the start of `main` to its end, or with
   ALLOCATION_FAULT_FROM=open from the first file that is opened, and has one return NULL: the n-th
   (ALLOCATION_FAULT_AT) alone, or with ALLOCATION_FAULT_KIND=on that one and all after it. What comes before
   `main` is the start of libraries, which no code of the tool's can guard. `operator new` of the C++ library
   calls `malloc`. The clock is stopped, so that outputs with a date can be compared.

   With ALLOCATION_FAULT_CONTROL, a socket, the process itself meets no fault: each child that it forks at an
   allocation does. That is the same run, without the start. It hands the status of each child over, with the
   number of the allocation, and goes on when it is answered. The first system call that changes a folder ends
   that, as a child would take the file away from its parent. In the end it hands over the number of all. */
#define _GNU_SOURCE
#include <dlfcn.h>
#include <errno.h>
#include <fcntl.h>
#include <stdarg.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <time.h>
#include <unistd.h>

struct Report {
  long call;
  long status;
  long outputBefore, errorsBefore; /* what the parent has written */
};

enum { kNoMoreChildren = -1, kEnd = -2, kLongestRun = 20 };

static int started = 0;
static int counting = 0;
static int forks = 0;
static int staysOn = 0;
static int control = -1;
static long calls = 0;
static long at = 0;
static long step = 1;
static long outputBefore = 0, errorsBefore = 0;

#define NEXT(name) ((__typeof__(&name))dlsym(RTLD_NEXT, #name))

/* Without the other side there is nothing left to do. */
static void handOver(long status) {
  const struct Report report = {calls, status, outputBefore, errorsBefore};
  char answer = 0;
  if (write(control, &report, sizeof report) != (ssize_t)sizeof report || read(control, &answer, 1) != 1)
    _exit(99);
}

/* 1 in a child that shall meet the fault. */
static int isChild(void) {
  int status = 0;
  outputBefore = lseek(STDOUT_FILENO, 0, SEEK_END);
  errorsBefore = lseek(STDERR_FILENO, 0, SEEK_END);
  const pid_t child = fork();
  if (child == 0) {
    forks = 0;
    at = calls;
    alarm(kLongestRun);
    return 1;
  }
  if (child < 0 || waitpid(child, &status, 0) != child) _exit(98);
  handOver(status);
  return 0;
}

static int strikes(void) {
  if (!counting) return 0;
  ++calls;
  const int isHit = forks ? calls % step == 0 && isChild() : at > 0 && (staysOn ? calls >= at : calls == at);
  if (isHit) errno = ENOMEM;
  return isHit;
}

static void endForks(void) {
  if (forks) handOver(kNoMoreChildren);
  forks = 0;
}

void* malloc(size_t size) {
  static void* (*next)(size_t) = NULL;
  if (next == NULL) next = NEXT(malloc);
  return strikes() ? NULL : next(size);
}

void* calloc(size_t count, size_t size) {
  static void* (*next)(size_t, size_t) = NULL;
  if (next == NULL) next = NEXT(calloc);
  return strikes() ? NULL : next(count, size);
}

void* realloc(void* block, size_t size) {
  static void* (*next)(void*, size_t) = NULL;
  if (next == NULL) next = NEXT(realloc);
  return strikes() ? NULL : next(block, size);
}

#ifdef SANITIZED
/* The sanitizer's `operator new` calls no `malloc`: these do, as those of the C++ library. */
extern void (*_ZSt15get_new_handlerv(void))(void);
extern void _ZSt17__throw_bad_allocv(void);

static void* newOrRaise(size_t size) {
  for (;;) {
    void* const block = malloc(size > 0 ? size : 1);
    if (block != NULL) return block;
    void (*const handler)(void) = _ZSt15get_new_handlerv();
    if (handler == NULL) _ZSt17__throw_bad_allocv();
    handler();
  }
}

void* _Znwm(size_t size) {
  return newOrRaise(size);
}
void* _Znam(size_t size) {
  return newOrRaise(size);
}
#endif

int open(const char* path, int flags, ...) {
  va_list arguments;
  va_start(arguments, flags);
  const mode_t mode = (flags & O_CREAT) != 0 ? va_arg(arguments, mode_t) : 0;
  va_end(arguments);
  counting = started;
  return NEXT(open)(path, flags, mode);
}

int mkostemp(char* pattern, int flags) {
  endForks();
  return NEXT(mkostemp)(pattern, flags);
}

int mkdir(const char* path, mode_t mode) {
  endForks();
  return NEXT(mkdir)(path, mode);
}

time_t time(time_t* stored) {
  if (stored != NULL) *stored = 0;
  return 0;
}

static long numberIn(const char* variable, long otherwise) {
  const char* text = getenv(variable);
  return text == NULL ? otherwise : atol(text);
}

typedef int (*MainFunction)(int, char**, char**);

static MainFunction toolMain = NULL;

static int countedMain(int count, char** arguments, char** environment) {
  const char* kind = getenv("ALLOCATION_FAULT_KIND");
  const char* from = getenv("ALLOCATION_FAULT_FROM");
  staysOn = kind != NULL && strcmp(kind, "on") == 0;
  at = numberIn("ALLOCATION_FAULT_AT", 0);
  step = numberIn("ALLOCATION_FAULT_STEP", 1);
  control = (int)numberIn("ALLOCATION_FAULT_CONTROL", -1);
  forks = control >= 0;
  started = 1;
  counting = from == NULL || strcmp(from, "open") != 0;
  const int result = toolMain(count, arguments, environment);
  /* What instruments the tool may write its results now. */
  started = counting = 0;
  return result;
}

/* The C library's way into `main`. */
int __libc_start_main(MainFunction start, int count, char** arguments, void (*first)(void),
                      void (*last)(void), void (*linkerLast)(void), void* stackEnd) {
  toolMain = start;
  return NEXT(__libc_start_main)(countedMain, count, arguments, first, last, linkerLast, stackEnd);
}

__attribute__((destructor)) static void reportEnd(void) {
  if (control >= 0 && at == 0) handOver(kEnd);
}
