#pragma once

#include <string>
#include <utility>
#include <vector>

namespace VK {

/// Names one managed element: an ordered list of key names and values, with a cursor on one of the pairs.
class Moniker {
public:
    Moniker();
    ~Moniker();
    Moniker(const Moniker&);
    Moniker& operator=(const Moniker&);

    /// Appends a pair. The cursor stays; before any selectKey it stands on the first pair, also when that comes later.
    void addKey(std::string name, const std::string& value);
    /// How many pairs there are.
    unsigned int getKeyCount() const;
    /// Puts the cursor on the pair of this index, counted from 0. Where there is no such pair: false, and the cursor
    /// stands on no pair until one is selected, whatever is added meanwhile; in a moniker without pairs, too.
    bool selectKey(unsigned int index);
    /// The current pair's name and value; false, with the argument untouched, on no pair.
    bool getName(std::string& name) const;
    bool getValue(std::string& value) const;

private:
    std::vector<std::pair<std::string, std::string>> keys;
    unsigned int current = 0;
};

} // namespace VK
