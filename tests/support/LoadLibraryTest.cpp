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

    // A data root without broker configurations: an instance needs a broker,
    // so initialize fails, with the bus's code and its registered text, and
    // leaves no instance. The broker tests initialize for real.
    setenv("VELDRA_DATA_DIR", "/nonexistent/kvveldra-load-test", 1);

    bool first = false, second = false;
    std::string error;
    Check(reserve(&first) == 0, "reserve");
    Check(reserve(&second) == 0, "second reserve");
    const int32_t status = initialize(7, nullptr, nullptr, nullptr, &error);
    std::printf("initialize without configurations: %d %s\n", status, error.c_str());
    Check(status < 0 && !error.empty(), "initialize without configurations fails with a text");
    error.clear();
    Check(closeInstance(0, &error) == 1 && error.empty(), "close instance 0 gives 1");
    Check(closeInstance(7, &error) == -251900, "a failed initialize leaves no instance");
    int32_t type = 0;
    Check(getDataType(0, false, &type, &error) == -251900, "reference 0 gives -251900");
    Check(error == "Invalid tag reference.", "reference 0 text");

    Check(unreserve(&first) == 0, "first unreserve");
    Check(getDataType(0, false, &type, &error) == -251900,
          "the registry lives on under the second reservation");
    Check(unreserve(&second) == 0, "second unreserve");
    Check(reserve(&first) == 0, "new reservation");
    Check(closeInstance(7, &error) == -251900, "the last unreserve cleared the tables");
    Check(unreserve(&first) == 0, "final unreserve");

    dlclose(library);
    std::printf("%d passed, %d failed\n", gPassed, gFailed);
    return gFailed == 0 ? 0 : 1;
}
