#include "Telephony/Modem/ModemChoice.h"

#include <algorithm>

namespace spectrel {

namespace {

/// The last part of an object path.
std::string_view number(const ModemFacts& modem)
{
    const std::string_view id = modem.id;
    return id.substr(id.rfind('/') + 1); // the whole id when there is no slash
}

bool equalButForCase(std::string_view left, std::string_view right)
{
    const auto lower = [](char character) {
        return character >= 'A' && character <= 'Z' ? static_cast<char>(character - 'A' + 'a') : character;
    };
    return std::equal(left.begin(), left.end(), right.begin(), right.end(),
        [&lower](char one, char other) { return lower(one) == lower(other); });
}

bool fits(const ModemFacts& modem, std::string_view wish)
{
    return wish.empty() || wish == number(modem) || wish == modem.id || equalButForCase(wish, modem.model)
        || equalButForCase(wish, modem.port);
}

int rank(const ModemFacts& modem)
{
    return modem.isRegistered ? 2 : modem.isEnabled ? 1 : 0;
}

} // namespace

const ModemFacts* chooseModem(const std::vector<ModemFacts>& modems, std::string_view wish, std::string_view current)
{
    const ModemFacts* best = nullptr;
    for (const ModemFacts& modem : modems) {
        if (!fits(modem, wish))
            continue;
        if (modem.id == current && modem.isEnabled)
            return &modem;
        if (!best || rank(modem) > rank(*best))
            best = &modem;
    }
    return best;
}

std::string modemName(const ModemFacts& modem)
{
    const std::string name = "modem " + std::string(number(modem));
    return modem.model.empty() ? name : name + " (" + modem.model + ")";
}

} // namespace spectrel
