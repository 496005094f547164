/// \file
/// One property of a search instance.
#pragma once
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/query/ModelElementConstrainables.h"

#include <concepts>

namespace tarn::kiln::query {

/// What the members of search instances have in common: the property, and the instance it is
/// attached to.
///
/// The instance must outlive it.
///
/// \tparam T           the C++ type of one value; for a property of a class type the handle.
/// \tparam Attachment  how the instance is known; offers `getInstance()`.
/// \tparam Flag        whether patterns can be asked for: the values are texts, and one is
/// required.
template <class T, class Attachment, bool Flag> class AbstractConstrainable
{
public:
    using Type = T;

    AbstractConstrainable(Attachment const& attachment, meta::Property const& property)
        : m_attachment(attachment),
          m_property(property)
    {}
    AbstractConstrainable(AbstractConstrainable const&) = default;
    AbstractConstrainable& operator=(AbstractConstrainable const&) = delete;

    Attachment const& getAttachment() const { return m_attachment; }
    meta::Property const& getProperty() const { return m_property; }

protected:
    void constrain(ValueMatchRelation relation, Value const& value) const
    {
        m_attachment.getInstance().constrain(m_property, relation, value);
    }
    template <class Member>
    void constrainByMember(ValueMatchRelation relation, Member const& other) const
    {
        m_attachment.getInstance().constrain(
            m_property, relation, other.getAttachment().getInstance(), other.getProperty());
    }

private:
    Attachment m_attachment;
    meta::Property m_property;
};

/// Only named, never called.
template <class T, class Attachment, bool Flag>
void takeMember(AbstractConstrainable<T, Attachment, Flag> const& member);

/// Whether `M` is a member of a search instance.
template <class M>
concept Constrainable = requires(M const& member)
{
    takeMember(member);
};

/// Whether `I` is a search instance.
template <class I>
concept SearchInstance = std::derived_from<I, ModelElement::Constrainables>;
}  // namespace tarn::kiln::query
