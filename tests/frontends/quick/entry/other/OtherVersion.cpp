// A module as another version of the program would have it.
#include "frontends/quick/entry/Module.h"

extern "C" {
extern const vespscope::quick::Module vespscopeQuickModule;
const vespscope::quick::Module vespscopeQuickModule{.version = "0.0.0", .obstacle = nullptr, .makeFrontend = nullptr};
}
