#include "text/decimal.h"

#include <locale>
#include <sstream>

namespace voreltext {

std::string decimal(double number) {
    std::ostringstream text;
    text.imbue(std::locale::classic());
    text << number;
    return text.str();
}

}  // namespace voreltext
