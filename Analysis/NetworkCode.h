#pragma once

#include <string>
#include <string_view>

namespace spectrel {

/// Reads network identities that the display shows now as digits, now as plain numbers.
///
/// Digits are three characters each, a blank standing for a third digit that a network code does not have. Plain
/// numbers have lost their leading zeros: where they are equal to the last digits these count; otherwise a network code
/// below 100 has two digits, but three in the countries that give out only such.
class NetworkCode {
public:
    /// "001-01"; empty where the texts are no network.
    std::string read(std::string_view country, std::string_view network);

private:
    std::string _digits; // the last that was read from digits
};

/// Whether the text is a network identity such as "001-01" or "310-260".
bool isNetworkCode(std::string_view text);

} // namespace spectrel
