// A password in memory that is wiped, and a process that leaves no picture of it behind.
#pragma once

#include <cstddef>
#include <string_view>

namespace seam {

/// The bytes of a password as they are typed, in memory that isn't swapped out, stands in no core
/// dump, and is wiped when it goes. What is taken out of it is wiped at once.
class Secret {
  public:
    static constexpr std::size_t capacity = 256;

    Secret();
    ~Secret();
    Secret(const Secret&) = delete;
    Secret& operator=(const Secret&) = delete;

    /// Adds one character in UTF-8; false, and the bytes as they were, if it doesn't fit.
    bool append(std::string_view character);
    void removeLast(); ///< the last character, however many bytes it has
    void clear();

    std::string_view bytes() const {
        return {memory_, size_};
    }

    std::size_t characters() const;

    /// All of the memory, also what holds nothing now: for a test that looks for remains.
    std::string_view memory() const {
        return {memory_, capacity};
    }

  private:
    void cutTo(std::size_t size);

    char* memory_;
    std::size_t size_ = 0;
};

/// While one lives the process leaves no core dump, and no other process of the user can look into
/// its memory.
class NoDumps {
  public:
    NoDumps();
    ~NoDumps();
    NoDumps(const NoDumps&) = delete;
    NoDumps& operator=(const NoDumps&) = delete;

  private:
    bool before_;
};

} // namespace seam
