// Walks the call order of the console family and prints each status and text:
// reserve, initialize, tag calls, close instance, unreserve.
#include <cstdio>
#include <string>

#include "kvveldra/TagConsole.h"

namespace {

int gUnexpected = 0;

void Show(const char* step, int32_t status, const std::string& error, int32_t expected) {
    std::printf("%-44s status %-8d %s\n", step, status, error.c_str());
    if (status != expected) {
        ++gUnexpected;
        std::printf("  expected status %d\n", expected);
    }
}

}  // namespace

int main() {
    bool reserved = false;
    std::string error;
    Show("TagConsoleReserve", TagConsoleReserve(&reserved), "", 0);

    Show("TagConsoleInitialize(0)", TagConsoleInitialize(0, nullptr, nullptr, nullptr, &error),
         error, 0);
    const std::string configuration = "veldra_localhost";
    const uint32_t timeoutMs = 5000;
    Show("TagConsoleInitialize(7, veldra_localhost)",
         TagConsoleInitialize(7, &configuration, &timeoutMs, nullptr, &error), error, 0);

    int32_t type = 0;
    error.clear();
    Show("TagConsoleGetDataType(reference 0)", TagConsoleGetDataType(0, true, &type, &error), error,
         -251900);
    error.clear();
    std::string path;
    Show("TagConsoleGetPath(reference 12345)", TagConsoleGetPath(12345, true, &path, &error), error,
         -251900);
    error.clear();
    Show("TagConsoleClose(reference 12345)", TagConsoleClose(12345, true, &error), error, -251900);

    error.clear();
    Show("TagConsoleCloseInstance(0)", TagConsoleCloseInstance(0, &error), error, 1);
    Show("TagConsoleCloseInstance(7)", TagConsoleCloseInstance(7, &error), error, 0);
    error.clear();
    Show("TagConsoleCloseInstance(7) again", TagConsoleCloseInstance(7, &error), error, -251900);
    Show("TagConsoleUnreserve", TagConsoleUnreserve(&reserved), "", 0);

    std::printf(gUnexpected == 0 ? "demo finished as expected\n" : "demo: %d unexpected\n",
                gUnexpected);
    return gUnexpected == 0 ? 0 : 1;
}
