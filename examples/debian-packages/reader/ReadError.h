/// \file
/// The error of everything that reads a package index.
#pragma once
#include <cstddef>
#include <stdexcept>
#include <string>

namespace debian {

/// A package index could not be read: it is missing, cut off or malformed.
///
/// `what()` is "file:line: reason", or "file: reason" when no line is to blame.
class ReadError : public std::runtime_error
{
public:
    /// \param line  counts from 1; 0 blames the file as a whole.
    ReadError(std::string const& file, std::size_t line, std::string const& reason);

    std::string const& file() const { return m_file; }
    std::size_t line() const { return m_line; }
    std::string const& reason() const { return m_reason; }

private:
    std::string m_file;
    std::size_t m_line;
    std::string m_reason;
};

}  // namespace debian
