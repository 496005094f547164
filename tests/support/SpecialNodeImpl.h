/// \file
/// What stands behind a `SpecialNode`.
#pragma once
#include "tarnkiln/support/Dispatch.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/SpecialNode.h"

namespace testkit {

/// The properties of a `SpecialNode`.
///
/// Written as generated classes are.
class SpecialNode::Impl : public support::Dispatched<SpecialNode::Impl, Node::Impl>
{
public:
    class BuilderImpl;                         // SpecialNodeBuilder.h
    template <class Final> class BuilderBase;  // SpecialNodeBuilder.h

    using Handle = SpecialNode;
    using Storage = support::Record<Impl, Node::Impl::Storage>;

    static constexpr unsigned long SLOTS = 33;
    static Slot const LEVEL;
    static Slot const MENTOR;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// A number.
    int getLevel() const { return m_level; }
    void setLevel(int level);

    /// A reference without an opposite.
    SpecialNode getMentor() const;
    /// Null if there is none; a proxy stays one.
    SpecialNode::Impl* getMentorImpl() const { return m_mentor.get(); }
    /// Whether there is one and it is live.
    bool hasMentor() const;
    void setMentor(SpecialNode const& mentor);

private:
    int m_level = 0;
    mutable support::CountedPointer<SpecialNode::Impl> m_mentor;

public:
    using Rows = support::RowList<
        support::Scalar<&Impl::m_level, LEVEL, &Impl::setLevel>,
        support::Reference<SpecialNode, &Impl::m_mentor, MENTOR, &Impl::setMentor>>;
};

inline SpecialNode::SpecialNode(Impl* impl) : Node(impl) {}
inline SpecialNode::Impl* SpecialNode::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline SpecialNode::Impl* SpecialNode::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace testkit

extern template class tarn::kiln::support::Record<testkit::SpecialNode::Impl,
                                                  testkit::Node::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<testkit::SpecialNode::Impl,
                                                      testkit::Node::Impl>;
