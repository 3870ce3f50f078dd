// Loads the shared library into a process that links nothing else of the
// project, and walks the reservation and instance calls through it.
#include <dlfcn.h>

#include <cstdio>
#include <cstdlib>
#include <string>

#include "kvveldra/TagConsole.h"

namespace {

int gFailed = 0;
int gPassed = 0;

void Check(bool condition, const char* what) {
    if (condition) {
        ++gPassed;
    } else {
        ++gFailed;
        std::fprintf(stderr, "FAILED: %s\n", what);
    }
}

template <typename Function>
Function Symbol(void* library, const char* name) {
    auto* symbol = reinterpret_cast<Function>(dlsym(library, name));
    if (symbol == nullptr) {
        std::fprintf(stderr, "missing export %s\n", name);
        std::exit(2);
    }
    return symbol;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 2) {
        std::fprintf(stderr, "usage: %s path/to/libkvveldra_tag.so\n", argv[0]);
        return 2;
    }
    void* library = dlopen(argv[1], RTLD_NOW | RTLD_LOCAL);
    if (library == nullptr) {
        std::fprintf(stderr, "dlopen: %s\n", dlerror());
        return 2;
    }
    auto reserve = Symbol<decltype(&TagConsoleReserve)>(library, "TagConsoleReserve");
    auto unreserve = Symbol<decltype(&TagConsoleUnreserve)>(library, "TagConsoleUnreserve");
    auto initialize = Symbol<decltype(&TagConsoleInitialize)>(library, "TagConsoleInitialize");
    auto closeInstance =
        Symbol<decltype(&TagConsoleCloseInstance)>(library, "TagConsoleCloseInstance");
    auto getDataType = Symbol<decltype(&TagConsoleGetDataType)>(library, "TagConsoleGetDataType");

    bool first = false, second = false;
    std::string error;
    Check(reserve(&first) == 0, "reserve");
    Check(reserve(&second) == 0, "second reserve");
    Check(initialize(0, nullptr, nullptr, nullptr, &error) == 0, "initialize 0");
    Check(initialize(7, nullptr, nullptr, nullptr, &error) == 0, "initialize 7");
    Check(closeInstance(0, &error) == 1 && error.empty(), "close instance 0 gives 1");
    int32_t type = 0;
    Check(getDataType(0, false, &type, &error) == -251900, "reference 0 gives -251900");
    Check(error == "Invalid tag reference.", "reference 0 text");

    Check(unreserve(&first) == 0, "first unreserve");
    Check(closeInstance(7, &error) == 0, "instance 7 lives on under the second reservation");
    Check(initialize(7, nullptr, nullptr, nullptr, &error) == 0, "initialize 7 again");
    Check(unreserve(&second) == 0, "second unreserve");
    Check(reserve(&first) == 0, "new reservation");
    Check(closeInstance(7, &error) == -251900, "the last unreserve cleared the tables");
    Check(unreserve(&first) == 0, "final unreserve");

    dlclose(library);
    std::printf("%d passed, %d failed\n", gPassed, gFailed);
    return gFailed == 0 ? 0 : 1;
}
