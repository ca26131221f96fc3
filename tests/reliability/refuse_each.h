#pragma once

#include <gtest/gtest.h>

#include <cstdio>
#include <string>

#include "allocation_watch.h"

/// Every request for memory of an operation refused, one after the other.
namespace vorel_test {

constexpr Refusal kRefusals[] = {Refusal::kOnce, Refusal::kFromThenOn};

inline const char* nameOf(Refusal refusal) {
    return refusal == Refusal::kOnce ? "refused once" : "refused from then on";
}

/// Calls `attempt(n)` with the n-th request refused, n from 1 until one attempt needs no refused
/// request, for both kinds of refusal. `attempt` returns whether its request was refused. Returns the
/// number of requests of an undisturbed attempt, and prints it.
template <class Attempt>
long refuseEach(const std::string& what, Attempt attempt) {
    long requests = 0;
    for (const Refusal refusal : kRefusals) {
        requests = 0;
        for (long n = 1;; ++n) {
            SCOPED_TRACE(what + ", request " + std::to_string(n) + " " + nameOf(refusal));
            const long before = liveBlocks();
            const bool refused = attempt(n, refusal);
            EXPECT_EQ(before, liveBlocks()) << "blocks leak";
            if (::testing::Test::HasFailure() || !refused) break;
            requests = n;
        }
    }
    std::printf("[ refusals ] %-36s %3ld requests, each refused alone and with all later ones\n",
                what.c_str(), requests);
    return requests;
}

}  // namespace vorel_test
