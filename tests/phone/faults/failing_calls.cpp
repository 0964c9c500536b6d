// Loaded into the viewer by LD_PRELOAD: lets calls of the system fail.
//
//   FAILING=malloc|new|open|write|connect|store   what is to fail
//   FAILING_AT=N        the N-th of them in the process; with FAILING_ON=1 all that follow, too
//   FAILING_AT=each     only with new: each of them, in a process of its own that goes no further
//   FAILING_COUNT=FILE  each of them adds a line to the file; with FAILING_AT=each the line says
//   how
//                       that process ended, as a shell gives it
//   FAILING_CLOCK=FILE  the first eight bytes are seconds by which the clock of the day is wrong
//
// malloc and new count where our own code calls them, new also where the standard library does;
// open where it is about the phone's files; write where it goes to a file; connect unless the test
// watches by it; store is a folder that cannot be written.

#include <dlfcn.h>
#include <fcntl.h>
#include <link.h>
#include <sched.h>
#include <sys/mman.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/time.h>
#include <sys/un.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <cstdarg>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <ctime>
#include <new>

extern "C" {
void* __libc_malloc(size_t size);
void* __libc_calloc(size_t count, size_t size);
void* __libc_realloc(void* old, size_t size);
}

namespace {

constexpr int kMostModules = 32;

struct Range {
  uintptr_t begin, end;
};

struct Plan {
  bool isOn = false;
  const char* what = "";
  long at = 0;
  bool goesOn = false;
  bool triesEach = false;
  int record = -1;
  const int64_t* clock = nullptr;
  Range ours[kMostModules] = {};
  int modules = 0;
};

Plan plan;
long calls = 0;
thread_local bool isInside = false;

template <typename Function>
Function real(const char* name) {
  return reinterpret_cast<Function>(dlsym(RTLD_NEXT, name));
}

int addModule(dl_phdr_info* module, size_t, void*) {
  const char* name = module->dlpi_name ? module->dlpi_name : "";
  const bool servesUs = strcmp(plan.what, "new") == 0 && strstr(name, "/libstdc++");
  if (*name && !strstr(name, "/libzelqo-") && !servesUs) return 0;
  for (int i = 0; i < module->dlpi_phnum; i++) {
    const auto& part = module->dlpi_phdr[i];
    if (part.p_type != PT_LOAD || !(part.p_flags & PF_X) || plan.modules == kMostModules) continue;
    const uintptr_t begin = module->dlpi_addr + part.p_vaddr;
    plan.ours[plan.modules++] = {begin, begin + part.p_memsz};
  }
  return 0;
}

const int64_t* mapClock(const char* file) {
  const int fd = open(file, O_RDONLY | O_CLOEXEC);
  void* clock = fd < 0 ? MAP_FAILED : mmap(nullptr, sizeof(int64_t), PROT_READ, MAP_SHARED, fd, 0);
  return clock == MAP_FAILED ? nullptr : static_cast<const int64_t*>(clock);
}

__attribute__((constructor)) void begin() {
  if (strcmp(program_invocation_short_name, "zelqo-viewer") != 0) return;
  const char* what = getenv("FAILING");
  const char* at = getenv("FAILING_AT");
  const char* count = getenv("FAILING_COUNT");
  if (const char* clock = getenv("FAILING_CLOCK")) plan.clock = mapClock(clock);
  plan.what = what ? what : "";
  dl_iterate_phdr(addModule, nullptr);
  plan.triesEach = at && strcmp(at, "each") == 0;
  plan.at = at ? atol(at) : 0;
  plan.goesOn = getenv("FAILING_ON") != nullptr;
  if (count) plan.record = open(count, O_WRONLY | O_CREAT | O_APPEND | O_CLOEXEC, 0644);
  plan.isOn = what != nullptr;
}

bool isOurs(const void* caller) {
  const auto address = reinterpret_cast<uintptr_t>(caller);
  for (int i = 0; i < plan.modules; i++) {
    if (address >= plan.ours[i].begin && address < plan.ours[i].end) return true;
  }
  return false;
}

void record(const char* line, size_t size) {
  if (plan.record < 0) return;
  isInside = true;
  [[maybe_unused]] const ssize_t written = write(plan.record, line, size);
  isInside = false;
}

/// Whether this call has to fail.
bool strikes(const char* what) {
  if (!plan.isOn || isInside || strcmp(plan.what, what) != 0) return false;
  const long number = __atomic_add_fetch(&calls, 1, __ATOMIC_RELAXED);
  record("\n", 1);
  return plan.at && (plan.goesOn ? number >= plan.at : number == plan.at);
}

int goWithoutMemory(void*) {
  if (const auto handler = std::get_new_handler()) handler();
  abort();  // as when nobody catches
}

/// What becomes of the process when there is no memory now: seen in one that shares ours, while
/// this thread waits.
void tryWithoutMemory() {
  const int error = errno;
  alignas(16) char stack[32 * 1024];
  isInside = true;
  int status = -1;
  const int process = clone(goWithoutMemory, stack + sizeof stack, CLONE_VM | CLONE_VFORK, nullptr);
  if (process > 0) waitpid(process, &status, __WCLONE);
  isInside = false;
  char line[16];
  const int ended = WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
  record(line, static_cast<size_t>(snprintf(line, sizeof line, "%d\n", ended)));
  errno = error;
}

bool allocationStrikes(const char* what, const void* caller) {
  return plan.isOn && isOurs(caller) && strikes(what);
}

bool isPhones(const char* path) {
  return path && strncmp(path, "/opt/usr/", 9) == 0;
}

int openError(const char* path, int flags) {
  if (!isPhones(path)) return 0;
  if (strikes("open")) return EMFILE;
  const bool writes = (flags & O_ACCMODE) != O_RDONLY || flags & O_CREAT;
  return writes && strikes("store") ? EROFS : 0;
}

bool writeStrikes(int fd) {
  struct stat status;
  return plan.isOn && !isInside && fd > STDERR_FILENO && fstat(fd, &status) == 0 &&
         S_ISREG(status.st_mode) && strikes("write");
}

bool isScreen(const sockaddr* address, socklen_t length) {
  if (address->sa_family != AF_UNIX || length <= sizeof(sa_family_t) + 1) return false;
  const char* path = reinterpret_cast<const sockaddr_un*>(address)->sun_path;
  const size_t size = length - sizeof(sa_family_t);
  return memmem(path, size, ".X11-unix", 9) != nullptr;
}

/// Over the toolkit's own connections goes the accessible tree, without which a test sees nothing.
bool isToolkits(const void* caller) {
  Dl_info module{};
  return dladdr(caller, &module) && module.dli_fname && strstr(module.dli_fname, "/libdbus-1.");
}

int fail(int error) {
  errno = error;
  return -1;
}

time_t wrong() {
  return plan.clock ? static_cast<time_t>(*plan.clock) : 0;
}

}  // namespace

void* operator new(size_t size) {
  if (plan.triesEach && !isInside && isOurs(__builtin_return_address(0))) tryWithoutMemory();
  if (!plan.triesEach && allocationStrikes("new", __builtin_return_address(0))) {
    if (const auto handler = std::get_new_handler()) handler();
    throw std::bad_alloc();
  }
  void* memory = __libc_malloc(size ? size : 1);
  if (!memory) throw std::bad_alloc();
  return memory;
}

void* operator new(size_t size, const std::nothrow_t&) noexcept {
  if (allocationStrikes("malloc", __builtin_return_address(0))) return nullptr;
  return __libc_malloc(size ? size : 1);
}

void operator delete(void* memory) noexcept {
  free(memory);
}

void operator delete(void* memory, size_t) noexcept {
  free(memory);
}

extern "C" {

void* malloc(size_t size) {
  if (allocationStrikes("malloc", __builtin_return_address(0))) return nullptr;
  return __libc_malloc(size);
}

void* calloc(size_t count, size_t size) {
  if (allocationStrikes("malloc", __builtin_return_address(0))) return nullptr;
  return __libc_calloc(count, size);
}

void* realloc(void* old, size_t size) {
  if (allocationStrikes("malloc", __builtin_return_address(0))) return nullptr;
  return __libc_realloc(old, size);
}

char* strdup(const char* text) {
  if (allocationStrikes("malloc", __builtin_return_address(0))) return nullptr;
  const size_t size = strlen(text) + 1;
  void* copy = __libc_malloc(size);
  return copy ? static_cast<char*>(memcpy(copy, text, size)) : nullptr;
}

int open(const char* path, int flags, ...) {
  va_list arguments;
  va_start(arguments, flags);
  const mode_t mode = flags & (O_CREAT | O_TMPFILE) ? va_arg(arguments, mode_t) : 0;
  va_end(arguments);
  const int error = openError(path, flags);
  return error ? fail(error) : openat(AT_FDCWD, path, flags, mode);
}

int open64(const char* path, int flags, ...) {
  va_list arguments;
  va_start(arguments, flags);
  const mode_t mode = flags & (O_CREAT | O_TMPFILE) ? va_arg(arguments, mode_t) : 0;
  va_end(arguments);
  const int error = openError(path, flags);
  return error ? fail(error) : openat(AT_FDCWD, path, flags | O_LARGEFILE, mode);
}

int mkdir(const char* path, mode_t mode) {
  static const auto next = real<int (*)(const char*, mode_t)>("mkdir");
  return isPhones(path) && strikes("store") ? fail(EROFS) : next(path, mode);
}

int rename(const char* from, const char* to) {
  static const auto next = real<int (*)(const char*, const char*)>("rename");
  return isPhones(to) && strikes("store") ? fail(EROFS) : next(from, to);
}

ssize_t write(int fd, const void* data, size_t size) {
  static const auto next = real<ssize_t (*)(int, const void*, size_t)>("write");
  return writeStrikes(fd) ? fail(ENOSPC) : next(fd, data, size);
}

ssize_t pwrite(int fd, const void* data, size_t size, off_t offset) {
  static const auto next = real<ssize_t (*)(int, const void*, size_t, off_t)>("pwrite");
  return writeStrikes(fd) ? fail(ENOSPC) : next(fd, data, size, offset);
}

ssize_t pwrite64(int fd, const void* data, size_t size, off64_t offset) {
  static const auto next = real<ssize_t (*)(int, const void*, size_t, off64_t)>("pwrite64");
  return writeStrikes(fd) ? fail(ENOSPC) : next(fd, data, size, offset);
}

int connect(int fd, const sockaddr* address, socklen_t length) {
  static const auto next = real<int (*)(int, const sockaddr*, socklen_t)>("connect");
  const bool counts = plan.isOn && address && !isScreen(address, length) &&
                      !isToolkits(__builtin_return_address(0));
  return counts && strikes("connect") ? fail(ECONNREFUSED) : next(fd, address, length);
}

time_t time(time_t* result) {
  timespec now;
  clock_gettime(CLOCK_REALTIME, &now);
  if (result) *result = now.tv_sec;
  return now.tv_sec;
}

int gettimeofday(timeval* __restrict now, void* __restrict) {
  timespec exact;
  clock_gettime(CLOCK_REALTIME, &exact);
  *now = {exact.tv_sec, exact.tv_nsec / 1000};
  return 0;
}

int clock_gettime(clockid_t clock, timespec* now) {
  static const auto next = real<int (*)(clockid_t, timespec*)>("clock_gettime");
  const int result = next(clock, now);
  if (result == 0 && clock == CLOCK_REALTIME) now->tv_sec += wrong();
  return result;
}
}
