#include "reader/ReadError.h"

namespace debian {
namespace {

std::string describe(std::string const& file, std::size_t line, std::string const& reason)
{
    return line == 0 ? file + ": " + reason : file + ":" + std::to_string(line) + ": " + reason;
}

}  // namespace

ReadError::ReadError(std::string const& file, std::size_t line, std::string const& reason)
    : std::runtime_error(describe(file, line, reason)),
      m_file(file),
      m_line(line),
      m_reason(reason)
{}

}  // namespace debian
