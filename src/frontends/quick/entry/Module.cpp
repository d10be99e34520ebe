#include "frontends/quick/entry/Module.h"

#include <string_view>
#include <system_error>

#include <dlfcn.h>

namespace vespscope::quick {
namespace {

// The loader's message, without the path with which it often begins.
std::string lastLoaderError(const std::string& path) {
  // Per thread in the C libraries that we build with.
  const char* words = ::dlerror();  // NOLINT(concurrency-mt-unsafe)
  std::string_view why = words == nullptr ? "no reason is known" : words;
  if (why.starts_with(path + ": ")) why.remove_prefix(path.size() + 2);
  return std::string(why);
}

}  // namespace

std::filesystem::path modulePath() {
  std::error_code failure;
  const std::filesystem::path program = std::filesystem::read_symlink("/proc/self/exe", failure);
  return program.parent_path().parent_path() / "lib" / "vespscope" / "quick.so";
}

Result<const Module*> loadModule(const std::filesystem::path& path) {
  const std::string name = path.string();
  const auto refusal = [&name](const std::string& why) { return Failure{name + " does not load: " + why}; };
  // Never closed: toolkits leave threads and exit handlers behind. RTLD_NOW reports missing symbols here.
  void* library = ::dlopen(name.c_str(), RTLD_NOW | RTLD_LOCAL);
  if (library == nullptr) return refusal(lastLoaderError(name));
  const auto* module = static_cast<const Module*>(::dlsym(library, moduleSymbol));
  if (module == nullptr) return refusal("it is no phone interface");
  if (module->version != std::string_view(VESPSCOPE_VERSION)) {
    return refusal(std::string("it is of version ") + module->version + ", not " VESPSCOPE_VERSION);
  }
  return module;
}

}  // namespace vespscope::quick
