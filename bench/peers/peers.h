#pragma once

#include "case.h"

/// Other programs' ways to the same pictures, or nearly so. They stand in the rows of the library's own
/// cases; docs/benchmarks.md says for each what is part of its figure.
namespace vorel_bench {

void addOpencvCases(Cases& cases);
/// The filters alone that the looks A and C need: a bound, not the looks.
void addOpencvLookFilters(Cases& cases, const Workload& workload);
void addPixmanCases(Cases& cases);
void addCairoCases(Cases& cases);
void addLibassCases(Cases& cases);
void addFreetypeCases(Cases& cases);

}  // namespace vorel_bench
