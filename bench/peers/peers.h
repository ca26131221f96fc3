#pragma once

#include "case.h"

/// Other programs' ways to the same pictures, or nearly so. They stand in the rows of the library's own
/// cases; docs/benchmarks.md says for each what is part of its figure.
namespace vorel_bench {

void addOpencvCases(Cases& cases);
void addPixmanCases(Cases& cases);
void addCairoCases(Cases& cases);
void addLibassCases(Cases& cases);
void addFreetypeCases(Cases& cases);

}  // namespace vorel_bench
