/// \file
/// The error of the parsers that know a text but no file.
#pragma once
#include <cstddef>
#include <stdexcept>
#include <string>

namespace debian {

/// The value of one field is malformed. `PackageParagraph` turns it into a `ReadError`.
class SyntaxError : public std::runtime_error
{
public:
    /// \param column  the byte of the text that is to blame, counted from 1; one past the last byte
    ///                if the text ends too early.
    SyntaxError(std::size_t column, std::string const& reason);

    std::size_t column() const { return m_column; }
    std::string const& reason() const { return m_reason; }

private:
    std::size_t m_column;
    std::string m_reason;
};

}  // namespace debian
