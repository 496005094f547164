#include "tarnkiln/meta/AbstractEvent.h"

namespace tarn::kiln::meta {

AbstractEvent::AbstractEvent(Operation const& operation, ModelElement const& owner)
    : m_operation(operation),
      m_owner(owner)
{}

AbstractEvent::~AbstractEvent() = default;
}  // namespace tarn::kiln::meta
