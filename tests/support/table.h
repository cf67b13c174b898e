// Tables of many short rows in one text, and the six comparisons at once.
#pragma once

#include <array>
#include <sstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

namespace support {

/// The words of a text. "''" stands for the empty one, "_" for a blank within one.
inline std::vector<std::string> words(const std::string& text) {
    std::istringstream in(text);
    std::vector<std::string> result;
    for (std::string word; in >> word;) {
        for (char& c : word)
            if (c == '_') c = ' ';
        result.push_back(word == "''" ? "" : word);
    }
    return result;
}

/// The same in rows of `columns` words.
template<std::size_t columns>
std::vector<std::array<std::string, columns>> rows(const std::string& text) {
    std::vector<std::array<std::string, columns>> result;
    std::size_t i = 0;
    for (const std::string& word : words(text)) {
        if (i % columns == 0) result.emplace_back();
        result.back()[i++ % columns] = word;
    }
    EXPECT_EQ(i % columns, 0u) << "a row lacks a word";
    return result;
}

/// A table of a type of its own, in which short rows share lines.
template<class... row>
auto list(const row&... rows) {
    return std::array{rows...};
}

/// `relation` is '<', '=' or '>'; anything else: neither equal nor in any order.
template<class A, class B>
bool stands(const A& a, char relation, const B& b) {
    const bool less = relation == '<', equal = relation == '=', greater = relation == '>';
    return (a == b) == equal && (a != b) == !equal && (a < b) == less && (a > b) == greater &&
           (a <= b) == (less || equal) && (a >= b) == (greater || equal);
}

/// Both lists hold the same ascending values, in two spellings.
template<class T>
void expect_order(const std::vector<std::string>& ascending, const std::vector<std::string>& respelled) {
    ASSERT_EQ(ascending.size(), respelled.size());
    for (std::size_t i = 0; i < ascending.size(); ++i)
        for (std::size_t j = 0; j < respelled.size(); ++j)
            EXPECT_TRUE(stands(T(ascending[i]), "=<>"[(i < j) + 2 * (i > j)], T(respelled[j])))
                << ascending[i] << " " << respelled[j];
}

} // namespace support
