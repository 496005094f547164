#include "tests/support/SpecialNodeImpl.h"

#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"
#include "tests/support/NodeMetamodel.h"
#include "tests/support/SpecialNodeBuilder.h"

namespace testkit {

constinit Slot const SpecialNode::Impl::LEVEL{.index = 31, .property = propertyOf<31>};
constinit Slot const SpecialNode::Impl::MENTOR{.index = 32, .property = propertyOf<32>};
SpecialNode SpecialNode::cast(ModelElement const& element)
{
    return support::cast<SpecialNode>(element);
}

meta::Class const& SpecialNode::metaClass()
{
    return NodeMetamodel::get().specialNode;
}

SpecialNode SpecialNode::create(Model const& model, UUID const& id)
{
    return support::create<SpecialNode>(model, id);
}

SpecialNode::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

SpecialNode::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

SpecialNode::Impl::~Impl() = default;

void SpecialNode::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

void SpecialNode::Impl::setLevel(int level)
{
    support::setScalar(*this, m_level, LEVEL, level);
}

SpecialNode SpecialNode::Impl::getMentor() const
{
    return SpecialNode(support::resolve(*this, m_mentor, MENTOR));
}

bool SpecialNode::Impl::hasMentor() const
{
    return m_mentor && m_mentor.get()->isLive();
}

void SpecialNode::Impl::setMentor(SpecialNode const& mentor)
{
    support::setReference(*this, m_mentor, MENTOR, mentor.getImpl());
}

SpecialNode::Builder::Builder() = default;

SpecialNode::Builder::Builder(Model const& model) : BuilderBase(model) {}

SpecialNode::Builder::~Builder() = default;
}  // namespace testkit

template class tarn::kiln::support::Record<testkit::SpecialNode::Impl,
                                           testkit::Node::Impl::Storage>;
template class tarn::kiln::support::Dispatched<testkit::SpecialNode::Impl, testkit::Node::Impl>;
template class tarn::kiln::support::BuilderValues<testkit::SpecialNode::Impl,
                                                  testkit::Node::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<testkit::SpecialNode::Builder>;
