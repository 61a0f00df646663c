#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace mof {

struct Token {
    enum class Kind { Real, Integer, Name, String, Pragma, Mark, End };

    Kind kind;
    std::string text; ///< as it is written; of a string what stands between the quotes, without escapes
    std::size_t line;
};

/// All tokens of a text, an end token last. Throws MofError at the first character that belongs to none.
std::vector<Token> readTokens(std::string_view text, const std::string& file);

} // namespace mof
