/// \file
/// What describes a new `SpecialNode` and makes it.
#pragma once
#include "tests/support/NodeBuilder.h"
#include "tests/support/SpecialNodeImpl.h"

namespace testkit {

/// The values of a `SpecialNode` to be.
class SpecialNode::Impl::BuilderImpl
    : public support::BuilderValues<SpecialNode::Impl, Node::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doSetLevel(int level) { m_level = level; }
    void doSetMentor(SpecialNode const& mentor) { m_mentor = mentor; }

private:
    int m_level = 0;
    SpecialNode m_mentor;

public:
    using Fields = support::BuilderFields<&BuilderImpl::m_level, &BuilderImpl::m_mentor>;
};

/// The setters of what a `SpecialNode` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final> class SpecialNode::Impl::BuilderBase : public Node::Impl::BuilderBase<Final>
{
    using Above = Node::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// A number.
    Final& setLevel(int level) { return this->give(LEVEL, &BuilderImpl::doSetLevel, level); }

    /// A reference without an opposite.
    Final& setMentor(SpecialNode const& mentor)
    {
        return this->give(MENTOR, &BuilderImpl::doSetMentor, mentor);
    }
};

/// Describes a `SpecialNode` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class SpecialNode::Builder final : public SpecialNode::Impl::BuilderBase<SpecialNode::Builder>
{
public:
    using Handle = SpecialNode;

    /// For a builder inside another one, whose model it takes.
    Builder();
    explicit Builder(Model const& model);
    ~Builder() override;

private:
    friend class support::BuilderTop<Builder>;

    Impl::BuilderImpl m_values{*this};
};
}  // namespace testkit

extern template class tarn::kiln::support::BuilderValues<testkit::SpecialNode::Impl,
                                                         testkit::Node::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<testkit::SpecialNode::Builder>;
