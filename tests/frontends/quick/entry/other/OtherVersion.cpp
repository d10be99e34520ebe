// A module of another version of the program.
#include "frontends/quick/entry/Module.h"

extern "C" {
extern const vespscope::quick::Module vespscopeQuickModule;
const vespscope::quick::Module vespscopeQuickModule{.version = "0.0.0", .obstacle = nullptr, .makeFrontend = nullptr};
}
