#include <cstdio>
#include <cstring>
#include <memory>
#include <regex>
#include <string>

#include "case.h"
#include "level.h"

/// One run of one row of the library, for a tool that counts instructions:
///
///     voreleffect_counts ROW [LEVEL]
///     voreleffect_counts --list [REGEX]    the rows, each with the pixels of a figure and its levels
///
/// vorelCountedCall is the function to count in.

extern "C" __attribute__((noinline)) void vorelCountedCall(vorel_bench::Job* job) {
    job->paint();
    asm volatile("" ::: "memory");  // not a tail call: the function must return to be left
}

namespace {

using namespace vorel_bench;

void list(const std::string& expression) {
    const std::regex wanted(expression);
    for (const Case& which : allCases()) {
        if (which.maker != kOurs || !std::regex_search(which.row, wanted)) continue;
        for (const Level& level : levels()) {
            std::printf("%s %s %lld\n", which.row.c_str(), level.label.c_str(),
                        static_cast<long long>(which.pixels));
        }
    }
}

bool choose(const char* label) {
    for (const Level& level : levels()) {
        if (label != nullptr && level.label != label) continue;
        level.choose();
        return true;
    }
    return false;
}

/// The first run meets what the library or the loader prepares once; the second is counted.
bool runOnce(const std::string& row) {
    for (const Case& which : allCases()) {
        if (which.maker != kOurs || which.row != row) continue;
        const std::unique_ptr<Job> job = which.make();
        job->reset();
        job->paint();
        job->reset();
        vorelCountedCall(job.get());
        return true;
    }
    return false;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc > 1 && std::strcmp(argv[1], "--list") == 0) {
        list(argc > 2 ? argv[2] : "");
        return 0;
    }
    if (argc < 2 || !choose(argc > 2 ? argv[2] : nullptr) || !runOnce(argv[1])) {
        std::fprintf(stderr, "usage: voreleffect_counts ROW [LEVEL] | --list [REGEX]\n");
        return 2;
    }
    return 0;
}
