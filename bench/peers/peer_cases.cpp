#include "peers.h"

namespace vorel_bench {

void addPeerCases(Cases& cases) {
    addOpencvCases(cases);
    addPixmanCases(cases);
    addCairoCases(cases);
    addLibassCases(cases);
    addFreetypeCases(cases);
}

}  // namespace vorel_bench
