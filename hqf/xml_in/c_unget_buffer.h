#pragma once

namespace lmx {

/// A stack of characters that were read and given back.
///
/// It holds three and checks nothing: whoever reads gives at most that many back before reading again.
class c_unget_buffer {
public:
    /// Precondition: fewer than three characters are held.
    void unget(int c) { held_[count_++] = c; }
    /// Takes the character given back last. Precondition: not empty.
    int get() { return held_[--count_]; }
    bool empty() const { return count_ == 0; }
    void clear() { count_ = 0; }

    /// How many are held, for the window.
    int size() const { return count_; }
    /// The character given back as number `index`, counted from 0, for the window.
    int at(int index) const { return held_[index]; }

private:
    int held_[3] = {};
    int count_ = 0;
};

} // namespace lmx
