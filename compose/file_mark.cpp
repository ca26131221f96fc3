#include "compose/file_mark.h"

#include <tuple>

namespace vorelcompose {
namespace {

auto tied(const FileMark& mark) {
    return std::tie(mark.device, mark.number, mark.size, mark.seconds, mark.nanoseconds);
}

}  // namespace

bool FileMark::operator==(const FileMark& other) const {
    return isSettled && other.isSettled && tied(*this) == tied(other);
}

}  // namespace vorelcompose
