#include "style/message.h"

namespace vorelstyle {

std::string printable(std::string text) {
    for (char& c : text) {
        if (static_cast<unsigned char>(c) < 0x20 || c == 0x7F) c = ' ';
    }
    return text;
}

std::string faultPrefix(std::string_view name) {
    return name.empty() ? "" : "style '" + std::string(name) + "': ";
}

}  // namespace vorelstyle
