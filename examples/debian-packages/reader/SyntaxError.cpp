#include "reader/SyntaxError.h"

namespace debian {

SyntaxError::SyntaxError(std::size_t column, std::string const& reason)
    : std::runtime_error("column " + std::to_string(column) + ": " + reason),
      m_column(column),
      m_reason(reason)
{}

}  // namespace debian
