#include "bedrock/core/except/MsgIDObj.h"

#include <utility>

namespace bedrock::core::except {

MsgIDObj::MsgIDObj(std::string id, std::string catalogue)
    : m_catalogue(std::move(catalogue)),
      m_id(std::move(id))
{}

std::string MsgIDObj::toString() const
{
    return m_catalogue + ':' + m_id;
}
}  // namespace bedrock::core::except
