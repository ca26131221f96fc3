#include "peers.h"

namespace vorel_bench {

void addPeerCases(Cases& cases) {
    addOpencvCases(cases);
    addPixmanCases(cases);
    addCairoCases(cases);
    addLibassCases(cases);
    addFreetypeCases(cases);
}

void addLookPeers(Cases& cases, const Workload& workload) {
    addOpencvLookFilters(cases, workload);
}

}  // namespace vorel_bench
