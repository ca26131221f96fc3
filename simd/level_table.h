#pragma once

#include <cstddef>

#include "simd/cpu_level.h"

#define VOREL_DECLARE_LEVEL_TABLE(level, Table, name) \
    namespace level {                                 \
    extern const Table name;                          \
    }
#if defined(VOREL_WITHOUT_VECTORS)
#define VOREL_LEVEL_TABLE_ADDRESS(level, Table, name) nullptr,
#else
#define VOREL_LEVEL_TABLE_ADDRESS(level, Table, name) &level::name,
#endif
#if defined(VOREL_WITHOUT_SCALAR)
#define VOREL_SCALAR_TABLE_ADDRESS(name) nullptr
#else
#define VOREL_SCALAR_TABLE_ADDRESS(name) &scalar::name
#endif

/// Defines `const Table& accessor(CpuLevel level)`, that level's table of inner loops, in the namespace
/// that it stands in. Each level that `eachLevel` names has defined `extern const Table name` in its own
/// namespace therein.
#define VOREL_LEVEL_TABLE(eachLevel, accessor, Table, name)                                            \
    VOREL_DECLARE_LEVEL_TABLE(scalar, Table, name)                                                     \
    eachLevel(VOREL_DECLARE_LEVEL_TABLE, Table, name) const Table& accessor(CpuLevel level) {          \
        static constexpr const Table* kTables[] = {VOREL_SCALAR_TABLE_ADDRESS(name),                   \
                                                   eachLevel(VOREL_LEVEL_TABLE_ADDRESS, Table, name)}; \
        return *kTables[static_cast<size_t>(level)];                                                   \
    }
