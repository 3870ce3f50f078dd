// The C++ side of write_bench.py: the median time of TagConsoleWriteTag of
// one double, each call with its sample made as a caller would (the text and
// the time now), after a warm-up. Uses the public header alone, on the data
// root that VELDRA_DATA_DIR names, instance 0.
//
//   python_write_bench PATH CALLS WARMUP    prints "p50_us <microseconds>"
#include <kvveldra/TagConsole.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <vector>

namespace {

using Clock = std::chrono::steady_clock;

int Fail(const char* step, int32_t status, const std::string& error) {
    std::fprintf(stderr, "python_write_bench: %s: status %d: %s\n", step, status, error.c_str());
    return 1;
}

int32_t WriteOne(uint32_t tag, double value, std::string& error) {
    const TagConsoleSamples samples{
        {std::to_string(value), std::chrono::time_point_cast<std::chrono::microseconds>(
                                    std::chrono::system_clock::now())}};
    return TagConsoleWriteTag(tag, 0, &samples, false, &error);
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 4) {
        std::fprintf(stderr, "usage: python_write_bench PATH CALLS WARMUP\n");
        return 2;
    }
    const std::string path = argv[1];
    const int calls = std::atoi(argv[2]);
    const int warmup = std::atoi(argv[3]);
    if (calls <= 0 || warmup < 0) {
        std::fprintf(stderr, "python_write_bench: CALLS must be above 0, WARMUP 0 or more\n");
        return 2;
    }
    bool reserved = false;
    std::string error;
    int32_t status = TagConsoleReserve(&reserved);
    if (status == 0) status = TagConsoleInitialize(0, nullptr, nullptr, nullptr, &error);
    if (status != 0) return Fail("initialize", status, error);
    uint32_t tag = 0;
    if ((status = TagConsoleOpen(0, &path, 0, false, &tag, &error)) != 0) {
        return Fail("open", status, error);
    }
    std::vector<double> micros;
    micros.reserve(static_cast<std::size_t>(calls));
    for (int i = 0; i < warmup + calls && status == 0; ++i) {
        const Clock::time_point start = Clock::now();
        status = WriteOne(tag, 12.5 + i, error);
        if (i >= warmup) {
            micros.push_back(std::chrono::duration<double, std::micro>(Clock::now() - start).count());
        }
    }
    if (status != 0) return Fail("write", status, error);
    TagConsoleClose(tag, false, &error);
    TagConsoleUnreserve(&reserved);
    std::nth_element(micros.begin(), micros.begin() + micros.size() / 2, micros.end());
    std::printf("p50_us %.3f\n", micros[micros.size() / 2]);
    return 0;
}
