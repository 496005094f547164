/// \file
/// What a proxy carries instead of contents.
#pragma once
#include "tarnkiln/kernel/ElementId.h"

#include <boost/optional.hpp>

namespace tarn::kiln {

/// Names an element, and the model that holds it unless that is the model of the proxy itself.
///
/// An absent model part and an empty one are equivalent in order and equality.
class TARNKILN_EXPORT ProxyId : public ElementId
{
public:
    ProxyId() = default;
    ProxyId(ustring type, ustring id, boost::optional<ustring> model = boost::none);
    ProxyId(ElementId element, boost::optional<ustring> model);

    boost::optional<ustring> const& getModelId() const { return m_model; }

    bool operator<(ProxyId const& other) const;
    bool operator==(ProxyId const& other) const;

private:
    ustring const& modelText() const;

    boost::optional<ustring> m_model;
};

/// Shows the parts to people, as `uuid:8d5a0ea6-... in file:books`.
TARNKILN_EXPORT std::ostream& operator<<(std::ostream& out, ProxyId const& id);
}  // namespace tarn::kiln
