/* Preloaded into the probes. Counts the calls by which a save reaches the disk, from the opening of its
   temporary file on or (SAVE_FAULT_FROM=start) from the first, and at the n-th (SAVE_FAULT_AT) ends the
   process (SAVE_FAULT_KIND=kill), fails as a full disk does, or (SAVE_FAULT_KIND=stays-full) does so from
   then on. In the folder SAVE_FAULT_DENIED nothing can be made, replaced or removed. */
#define _GNU_SOURCE
#include <dlfcn.h>
#include <errno.h>
#include <fcntl.h>
#include <signal.h>
#include <stdarg.h>
#include <stdlib.h>
#include <string.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <sys/types.h>
#include <unistd.h>

static int counting = 0;
static int calls = 0;

/* 1 when this call shall fail. Does not return when it shall end the process. A disk that stays full refuses
   what takes room, and nothing else. */
static int strikes(int takesRoom) {
  const char* at = getenv("SAVE_FAULT_AT");
  const char* kind = getenv("SAVE_FAULT_KIND");
  if (getenv("SAVE_FAULT_FROM") != NULL) counting = 1;
  if (!counting || at == NULL) return 0;
  ++calls;
  const int stays = kind != NULL && strcmp(kind, "stays-full") == 0;
  if (stays ? !takesRoom || calls < atoi(at) : calls != atoi(at)) return 0;
  if (kind != NULL && strcmp(kind, "kill") == 0) raise(SIGKILL);
  errno = ENOSPC;
  return 1;
}

/* 1, with the reason, for a path in the folder that is write-protected. */
static int denies(const char* path) {
  const char* folder = getenv("SAVE_FAULT_DENIED");
  if (folder == NULL || strncmp(path, folder, strlen(folder)) != 0) return 0;
  errno = EACCES;
  return 1;
}

#define NEXT(name) ((__typeof__(&name))dlsym(RTLD_NEXT, #name))

int open(const char* path, int flags, ...) {
  va_list arguments;
  va_start(arguments, flags);
  const mode_t mode = (flags & O_CREAT) != 0 ? va_arg(arguments, mode_t) : 0;
  va_end(arguments);
  if (strikes((flags & O_CREAT) != 0) || ((flags & O_CREAT) != 0 && denies(path))) return -1;
  return NEXT(open)(path, flags, mode);
}

int mkostemp(char* pattern, int flags) {
  counting = 1;
  return strikes(1) || denies(pattern) ? -1 : NEXT(mkostemp)(pattern, flags);
}

ssize_t write(int descriptor, const void* bytes, size_t count) {
  if (descriptor > 2 && strikes(1)) {
    /* A full disk takes a part first. */
    if (count > 1) NEXT(write)(descriptor, bytes, count / 2);
    errno = ENOSPC;
    return -1;
  }
  return NEXT(write)(descriptor, bytes, count);
}

int fsync(int descriptor) { return strikes(1) ? -1 : NEXT(fsync)(descriptor); }

int close(int descriptor) {
  if (strikes(0)) {
    NEXT(close)(descriptor);
    errno = EIO;
    return -1;
  }
  return NEXT(close)(descriptor);
}

int fstat(int descriptor, struct stat* status) { return strikes(0) ? -1 : NEXT(fstat)(descriptor, status); }

int stat(const char* path, struct stat* status) { return strikes(0) ? -1 : NEXT(stat)(path, status); }

int lstat(const char* path, struct stat* status) { return strikes(0) ? -1 : NEXT(lstat)(path, status); }

int flock(int descriptor, int operation) { return strikes(0) ? -1 : NEXT(flock)(descriptor, operation); }

int access(const char* path, int mode) { return strikes(0) ? -1 : NEXT(access)(path, mode); }

ssize_t readlink(const char* path, char* target, size_t room) {
  return strikes(0) ? -1 : NEXT(readlink)(path, target, room);
}

int fchown(int descriptor, uid_t owner, gid_t group) { return strikes(0) ? -1 : NEXT(fchown)(descriptor, owner, group); }

int fchmod(int descriptor, mode_t mode) { return strikes(0) ? -1 : NEXT(fchmod)(descriptor, mode); }

int rename(const char* from, const char* to) { return strikes(1) || denies(to) ? -1 : NEXT(rename)(from, to); }

int mkdir(const char* path, mode_t mode) { return strikes(1) || denies(path) ? -1 : NEXT(mkdir)(path, mode); }

int unlink(const char* path) { return strikes(0) || denies(path) ? -1 : NEXT(unlink)(path); }
