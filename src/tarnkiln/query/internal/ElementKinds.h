/// \file
/// What a run knows about the elements of one kind.
#pragma once
#include "tarnkiln/meta/internal/PlainPlace.h"
#include "tarnkiln/query/internal/NativeQueryState.h"
#include "tarnkiln/query/internal/ValueTest.h"

#include <array>
#include <cstddef>
#include <memory>
#include <typeinfo>
#include <unordered_map>
#include <vector>

namespace tarn::kiln::internal {

/// One constraint, in the form that suits the elements of one kind.
struct ElementTest
{
    SingleObjectConstraint const* constraint = nullptr;
    bool isTopLevel = false;                                           ///< Asks for that only.
    PropertyRelationValueConstraint const* valueConstraint = nullptr;  ///< If it is one.
    PlainPlace place;
    ValueTest test;          ///< What the value at `place` is tested for.
    bool isOfField = false;  ///< The value is a required field, and is compared.
};

/// The tests of one search instance, after that of the class.
struct InstanceTests
{
    std::size_t instance;
    std::vector<ElementTest> tests;
};

/// What elements of one kind are tested for: the search instances that they can stand for.
struct ElementKind
{
    /// Something in memory that is read first, after the C++ class of the element.
    void const* touched(ModelElement::Impl const& element) const
    {
        return isReflective ? &cellsOf(element) : firstPlace.field(element);
    }

    std::vector<InstanceTests> instances;
    std::type_info const* type = nullptr;  ///< The C++ class.
    bool isReflective = false;
    PlainPlace firstPlace;  ///< That is read.
};

/// Sorts the elements that a run meets into kinds, each of which is looked into once.
///
/// Elements that must be asked for their values are sorted by metaclass, for which each is asked.
class ElementKinds
{
public:
    ElementKinds(NativeQueryState const& query, RegexCache& regexes);

    /// \param type  the C++ class of `element`.
    ElementKind const& kindOf(std::type_info const& type, ModelElement::Impl const& element)
    {
        Cached const& cached = m_byType.at(&type);
        return cached.key == &type ? *cached.kind : findKind(type, element);
    }

private:
    struct Cached
    {
        void const* key = nullptr;
        ElementKind const* kind = nullptr;
    };
    class Cache
    {
    public:
        /// Where what is kept for `key` is or would be.
        Cached& at(void const* key)
        {
            auto const bits = reinterpret_cast<std::uintptr_t>(key);
            return m_all[(bits >> 4 ^ bits >> 10) % m_all.size()];
        }

    private:
        std::array<Cached, 64> m_all;
    };

    ElementKind const& findKind(std::type_info const& type, ModelElement::Impl const& element)
    {
        if (&type != m_lastType)
            useType(type, element);
        void const* const key = keyOf(type, element);
        Cached& cached = (m_lastBy == KeptBy::Class ? m_byType : m_byKey).at(key);
        if (cached.key != key || !cached.kind)
            cached = {key, &makeOrFind(key, element)};
        return *cached.kind;
    }
    void const* keyOf(std::type_info const& type, ModelElement::Impl const& element) const
    {
        if (m_lastBy == KeptBy::Class)
            return &type;
        return m_lastBy == KeptBy::Layout
                   ? static_cast<void const*>(&cellsOf(element).layout())
                   : static_cast<void const*>(element.getMetaClass().getElementImpl());
    }
    void useType(std::type_info const& type, ModelElement::Impl const& element);
    ElementKind const& makeOrFind(void const* key, ModelElement::Impl const& element);
    ElementKind makeKind(ModelElement::Impl const& element);
    ElementTest makeTest(SingleObjectConstraint const& constraint,
                         ModelElement::Impl const& element);

    NativeQueryState const& m_query;
    ValueTests m_tests;
    std::type_info const* m_lastType = nullptr;
    KeptBy m_lastBy = KeptBy::Nobody;  ///< How elements of `m_lastType` are sorted.
    std::unordered_map<std::type_info const*, KeptBy> m_by;
    std::unordered_map<void const*, std::unique_ptr<ElementKind>> m_kinds;
    Cache m_byType;  ///< For generated classes.
    Cache m_byKey;   ///< For all others.
};
}  // namespace tarn::kiln::internal
