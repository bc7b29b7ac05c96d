// SPDX-License-Identifier: MIT
//
// Loaded into a program by LD_PRELOAD, makes its calls fail that can fail. Between the beginning
// and the end of main it counts them, and the environment says which are to fail:
//
//     TORTURE_MODE=once     the call TORTURE_CALL of all, counted from 1
//     TORTURE_MODE=memory   the memory call TORTURE_CALL and every later one
//     TORTURE_MODE=short    none; but from the call TORTURE_CALL on, reads and writes move one byte
//
// When the program ends, a line in the file TORTURE_REPORT says how many calls there were, how many
// of them concerned memory, what failed first, and what was not given back:
//
//     calls 61 memory 40 failed write blocks 0 descriptors 0
#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdarg>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <dlfcn.h>
#include <fcntl.h>
#include <link.h>
#include <sys/stat.h>
#include <sys/uio.h>
#include <unistd.h>

extern "C" {
void* __libc_malloc(std::size_t size);
void* __libc_calloc(std::size_t count, std::size_t size);
void* __libc_realloc(void* block, std::size_t size);
void* __libc_memalign(std::size_t alignment, std::size_t size);
void __libc_free(void* block);
}

namespace {

enum class Mode { None, Once, Memory, Short };

Mode mode = Mode::None;
long chosen = 0;
bool counting = false;
long calls = 0;
long memoryCalls = 0;
const char* failed = "nothing";
long descriptors = 0;

// Where the C library lies. It keeps some of what it asks for, and may ask for more where something
// fails; that is no business of the program.
std::uintptr_t libraryBegin = 0;
std::uintptr_t libraryEnd = 0;

int findLibrary(dl_phdr_info* object, std::size_t /*size*/, void* /*data*/) {
    if (std::strstr(object->dlpi_name, "/libc.so") != nullptr) {
        libraryBegin = object->dlpi_addr;
        for (int i = 0; i < object->dlpi_phnum; ++i) {
            const auto& part = object->dlpi_phdr[i];
            libraryEnd = std::max(libraryEnd, libraryBegin + part.p_vaddr + part.p_memsz);
        }
    }
    return 0;
}

// The blocks of memory that the program has asked for and not given back: an open hash table. The
// program has few at a time.
constexpr std::size_t kSlots = std::size_t{1} << 20;
constexpr std::size_t kWindow = 64;
std::array<void*, kSlots + kWindow> blocks;
long blockCount = 0;

void** slotOf(void* block, const void* wanted) {
    const std::size_t first =
        (reinterpret_cast<std::uintptr_t>(block) >> 4U) * 0x9E3779B1U % kSlots;
    for (std::size_t at = first; at < first + kWindow; ++at) {
        if (blocks[at] == wanted) {
            return &blocks[at];
        }
    }
    return nullptr;
}

void* given(void* block, const void* caller) {
    const auto place = reinterpret_cast<std::uintptr_t>(caller);
    const bool isLibrary = libraryBegin <= place && place < libraryEnd;
    if (counting && block != nullptr && !isLibrary) {
        if (void** const slot = slotOf(block, nullptr); slot != nullptr) {
            *slot = block;
            ++blockCount;
        }
    }
    return block;
}

void takenBack(void* block) {
    if (block != nullptr) {
        if (void** const slot = slotOf(block, block); slot != nullptr) {
            *slot = nullptr;
            --blockCount;
        }
    }
}

bool fails(const char* name, bool isMemory) {
    if (!counting) {
        return false;
    }
    ++calls;
    memoryCalls += isMemory ? 1 : 0;
    const bool now = (mode == Mode::Once && calls == chosen)
                     || (mode == Mode::Memory && isMemory && memoryCalls >= chosen);
    if (now && std::strcmp(failed, "nothing") == 0) {
        failed = name;
    }
    return now;
}

bool failsWith(int error, const char* name, bool isMemory = false) {
    const bool now = fails(name, isMemory);
    if (now) {
        errno = error;
    }
    return now;
}

std::size_t shortened(std::size_t size) {
    return counting && mode == Mode::Short && calls >= chosen && size > 1 ? 1 : size;
}

// The C library's own function behind one of ours.
template <typename Function>
Function* next(Function* /*ours*/, const char* name) {
    return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

void report() {
    const char* const path = std::getenv("TORTURE_REPORT");
    if (path == nullptr || calls == 0) {
        return;
    }
    counting = false;
    std::array<char, 200> line{};
    const int size = std::snprintf(line.data(), line.size(),
                                   "calls %ld memory %ld failed %s blocks %ld descriptors %ld\n",
                                   calls, memoryCalls, failed, blockCount, descriptors);
    const int file = open(path, O_WRONLY | O_CREAT | O_TRUNC, 0666);
    (void)!write(file, line.data(), static_cast<std::size_t>(size));
    close(file);
    calls = 0;
}

using Main = int(int, char**, char**);
Main* realMain = nullptr;

int tortured(int argc, char** argv, char** environment) {
    counting = true;
    const int status = realMain(argc, argv, environment);
    counting = false;
    return status;
}

__attribute__((constructor)) void begin() {
    dl_iterate_phdr(findLibrary, nullptr);
    const char* const name = std::getenv("TORTURE_MODE");
    const char* const call = std::getenv("TORTURE_CALL");
    if (name != nullptr && call != nullptr) {
        chosen = std::atol(call);
        mode = std::strcmp(name, "once") == 0     ? Mode::Once
               : std::strcmp(name, "memory") == 0 ? Mode::Memory
                                                  : Mode::Short;
    }
}

__attribute__((destructor)) void end() {
    report();
}

}  // namespace

extern "C" {

void* malloc(std::size_t size) {
    return failsWith(ENOMEM, "malloc", true)
               ? nullptr
               : given(__libc_malloc(size), __builtin_return_address(0));
}

void* calloc(std::size_t count, std::size_t size) {
    return failsWith(ENOMEM, "calloc", true)
               ? nullptr
               : given(__libc_calloc(count, size), __builtin_return_address(0));
}

void* realloc(void* block, std::size_t size) {
    if (failsWith(ENOMEM, "realloc", true)) {
        return nullptr;
    }
    takenBack(block);
    return given(__libc_realloc(block, size), __builtin_return_address(0));
}

void* aligned_alloc(std::size_t alignment, std::size_t size) {
    return failsWith(ENOMEM, "aligned_alloc", true)
               ? nullptr
               : given(__libc_memalign(alignment, size), __builtin_return_address(0));
}

void free(void* block) {
    takenBack(block);
    __libc_free(block);
}

int open(const char* path, int flags, ...) {
    static auto* const real = next(open, "open");
    if (failsWith(EMFILE, "open")) {
        return -1;
    }
    va_list rest;
    va_start(rest, flags);
    const mode_t permissions = (flags & O_CREAT) != 0 ? va_arg(rest, mode_t) : 0;
    va_end(rest);
    const int descriptor = real(path, flags, permissions);
    descriptors += counting && descriptor >= 0 ? 1 : 0;
    return descriptor;
}

int close(int descriptor) {
    static auto* const real = next(close, "close");
    const int result = real(descriptor);
    descriptors -= counting && result == 0 && descriptor > STDERR_FILENO ? 1 : 0;
    return failsWith(EIO, "close") ? -1 : result;
}

int fstat(int descriptor, struct stat* status) {
    static auto* const real = next(fstat, "fstat");
    return failsWith(EIO, "fstat") ? -1 : real(descriptor, status);
}

ssize_t read(int descriptor, void* bytes, std::size_t size) {
    static auto* const real = next(read, "read");
    return failsWith(EIO, "read") ? -1 : real(descriptor, bytes, shortened(size));
}

ssize_t write(int descriptor, const void* bytes, std::size_t size) {
    static auto* const real = next(write, "write");
    const char* const name = descriptor == STDERR_FILENO ? "message" : "write";
    return failsWith(ENOSPC, name) ? -1 : real(descriptor, bytes, shortened(size));
}

void _exit(int status) {
    static auto* const real = next(_exit, "_exit");
    report();
    real(status);
    __builtin_unreachable();
}

int __libc_start_main(Main* program, int argc, char** argv, void (*init)(), void (*fini)(),
                      void (*loaderFini)(), void* stackEnd) {
    static auto* const real = next(__libc_start_main, "__libc_start_main");
    realMain = program;
    return real(tortured, argc, argv, init, fini, loaderFini, stackEnd);
}
}
