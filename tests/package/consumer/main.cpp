// Reserves the library, opens an instance on a configuration whose broker
// does not answer and unreserves again. Opening the instance makes the library
// load its TLS start-up library before it connects, so a connection error,
// not a load error, says that the library found it. Prints where the library
// itself was loaded from.
#include <dlfcn.h>

#include <cstdio>
#include <cstdlib>
#include <string>

#include "kvveldra/TagConsole.h"

int main(int argc, char** argv) {
    if (argc != 2) {
        std::fprintf(stderr, "usage: consumer CONFIGURATION-ID\n");
        return 2;
    }
    Dl_info info{};
    if (dladdr(reinterpret_cast<void*>(&TagConsoleReserve), &info) == 0 ||
        info.dli_fname == nullptr) {
        std::fprintf(stderr, "consumer: cannot tell where TagConsoleReserve lives\n");
        return 1;
    }
    std::printf("library: %s\n", info.dli_fname);

    bool reserved = false;
    const int32_t reserveStatus = TagConsoleReserve(&reserved);
    std::printf("TagConsoleReserve: status %d, reserved %d\n", reserveStatus, reserved ? 1 : 0);
    if (reserveStatus != 0 || !reserved) return 1;

    const std::string configuration = argv[1];
    const uint32_t timeoutMs = 300;
    const bool allowFallback = false;
    std::string error;
    const int32_t initializeStatus =
        TagConsoleInitialize(7, &configuration, &timeoutMs, &allowFallback, &error);
    std::printf("TagConsoleInitialize: status %d: %s\n", initializeStatus, error.c_str());
    bool failed = false;
    if (initializeStatus >= 0) {
        std::fprintf(stderr, "consumer: TagConsoleInitialize did not fail without a broker\n");
        failed = true;
    }
    if (error.find("KV-SSL") != std::string::npos) {
        std::fprintf(stderr, "consumer: the library did not load libkvsslinit.so.13\n");
        failed = true;
    }

    bool unreserved = true;
    const int32_t unreserveStatus = TagConsoleUnreserve(&unreserved);
    std::printf("TagConsoleUnreserve: status %d, reserved %d\n", unreserveStatus,
                unreserved ? 1 : 0);
    if (unreserveStatus != 0 || unreserved) failed = true;
    return failed ? 1 : 0;
}
