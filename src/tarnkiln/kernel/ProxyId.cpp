#include "tarnkiln/kernel/ProxyId.h"

#include <utility>

namespace tarn::kiln {

ProxyId::ProxyId(ustring type, ustring id, boost::optional<ustring> model)
    : ElementId(std::move(type), std::move(id)),
      m_model(std::move(model))
{}

ProxyId::ProxyId(ElementId element, boost::optional<ustring> model)
    : ElementId(std::move(element)),
      m_model(std::move(model))
{}

bool ProxyId::operator<(ProxyId const& other) const
{
    int const byElement = compare(other);
    return byElement != 0 ? byElement < 0 : modelText() < other.modelText();
}

bool ProxyId::operator==(ProxyId const& other) const
{
    return compare(other) == 0 && modelText() == other.modelText();
}

ustring const& ProxyId::modelText() const
{
    static ustring const NONE;
    return m_model ? *m_model : NONE;
}
}  // namespace tarn::kiln
