#include "app/windows_module.h"

#include <dlfcn.h>

#include <cstdio>
#include <filesystem>
#include <system_error>

namespace zv {
namespace {

// Beside the running program, wherever it was started from.
std::filesystem::path ModulePath() {
    std::error_code ec;
    const std::filesystem::path program = std::filesystem::read_symlink("/proc/self/exe", ec);
    const std::filesystem::path name = ZV_WINDOWS_MODULE;
    return ec ? name : program.parent_path() / name;
}

}  // namespace

int RunWithWindows(int argc, char** argv) {
    const std::filesystem::path path = ModulePath();
    void* module = dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL);
    using Entry = decltype(&zv_run_with_windows);
    auto entry = module ? reinterpret_cast<Entry>(dlsym(module, kWindowsEntryName)) : nullptr;
    if (!entry) {
        std::fprintf(stderr, "zorvane-filer: cannot load its windows: %s\n", dlerror());
        return 1;
    }
    // Left loaded: Qt's objects and exit handlers from it live until the process ends.
    return entry(argc, argv);
}

}  // namespace zv
