// A file that is written beside its place and put there when it is whole.
#pragma once

#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

using Bytes = std::vector<std::uint8_t>;

/// Throws a std::runtime_error: the path and what the error number means.
[[noreturn]] void FailWith(const std::string& path, int error);

/// Each operation throws as above. A file that isn't put into its place goes with its record.
class OutFile {
  public:
    /// What stands at the path already has to be a regular file that isn't
    /// read-only; a link to one stays a link.
    explicit OutFile(const std::string& path);
    OutFile(const OutFile&) = delete;
    OutFile& operator=(const OutFile&) = delete;
    ~OutFile();

    void write(const void* bytes, std::size_t count);

    /// Writes over what stands at a place that has been written.
    void writeAt(long place, const Bytes& bytes);

    /// Puts the file into its place, with the mode of the one it replaces or that of a new file.
    void commit();

  private:
    std::string shown_; // the path as the user gave it
    std::string target_;
    std::string beside_;
    std::FILE* file_ = nullptr;
};
