/// \file
/// What ties a member of a search instance to the instance.
#pragma once
#include "tarnkiln/kernel/ModelElement.h"

namespace tarn::kiln::query {

/// The search instance that a member belongs to, of whatever class that is.
///
/// A reference in the form of a value: the instance must outlive it.
class InstanceAttachment
{
public:
    InstanceAttachment(ModelElement::Constrainables& instance) : m_instance(&instance) {}

    ModelElement::Constrainables& getInstance() const { return *m_instance; }

private:
    ModelElement::Constrainables* m_instance;  // never null
};
}  // namespace tarn::kiln::query
