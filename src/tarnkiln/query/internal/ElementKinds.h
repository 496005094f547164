/// \file
/// What a run knows about the elements of one kind.
#pragma once
#include "tarnkiln/meta/internal/PlainPlace.h"
#include "tarnkiln/query/internal/AssociatedObjectConstraint.h"
#include "tarnkiln/query/internal/NativeQueryState.h"
#include "tarnkiln/query/internal/ReferencePlace.h"
#include "tarnkiln/query/internal/ValueTest.h"

#include <array>
#include <cstddef>
#include <memory>
#include <typeinfo>
#include <unordered_map>
#include <utility>
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
    bool isInPlace = false;  ///< A single value there is compared.
};

/// What becomes of an element of a kind that can stand for a search instance.
struct InstanceTests
{
    std::size_t instance;
    std::vector<ElementTest> tests;  ///< After that of the class.
    /// The references that are followed from there, by their number, and where it keeps them.
    std::vector<std::pair<std::size_t, ReferencePlace>> followed;
};

/// What elements of one kind are tested for: the search instances that they can stand for.
struct ElementKind
{
    /// What is read of each first, after its C++ class, in bytes behind where it begins.
    using Places = std::array<std::ptrdiff_t, 3>;

    /// Whether the element certainly is of this kind.
    bool isOf(ModelElement::Impl const& element) const
    {
        return &typeid(element) == type && (!layout || layout == &cellsOf(element).layout());
    }

    std::vector<InstanceTests> instances;
    Places places{};
    std::type_info const* type = nullptr;  ///< Null if that does not tell.
    ReflectiveLayout const* layout = nullptr;
};

/// Sorts the elements that a run meets into kinds, each of which is looked into once.
///
/// Elements that must be asked for their values are sorted by metaclass, for which each is asked.
class ElementKinds
{
public:
    ElementKinds(NativeQueryState const& query, RegexCache& regexes);

    ElementKind const& kindOf(ModelElement::Impl const& element)
    {
        std::type_info const& type = typeid(element);
        Cached const& byType = m_byType.at(&type);
        if (byType.key == &type)
        {
            if (byType.kind)
                return *byType.kind;
            void const* const layout = &cellsOf(element).layout();
            Cached const& byLayout = m_byKey.at(layout);
            if (byLayout.key == layout)
                return *byLayout.kind;
        }
        return findKind(type, element);
    }

    /// The joins that follow a reference with one value, of which some elements may keep it where
    /// it can be looked at. Their numbers are those in `InstanceTests`.
    std::vector<AssociatedObjectConstraint const*> const& getFollowed() const { return m_followed; }

private:
    struct Cached
    {
        void const* key = nullptr;
        ElementKind const* kind = nullptr;  ///< Null if the layout decides.
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
        if (cached.key != key || !cached.kind)  // the key of no metaclass is null
            cached = {key, &makeOrFind(key, element)};
        if (m_lastBy == KeptBy::Layout)
            m_byType.at(&type) = {&type, nullptr};
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
    void addFollowed(InstanceTests& instance, ModelElement::Impl const& element) const;
    ElementTest makeTest(SingleObjectConstraint const& constraint,
                         ModelElement::Impl const& element);

    NativeQueryState const& m_query;
    ValueTests m_tests;
    std::vector<AssociatedObjectConstraint const*> m_followed;
    std::type_info const* m_lastType = nullptr;
    KeptBy m_lastBy = KeptBy::Nobody;  ///< How elements of `m_lastType` are sorted.
    std::unordered_map<std::type_info const*, KeptBy> m_by;
    std::unordered_map<void const*, std::unique_ptr<ElementKind>> m_kinds;
    Cache m_byType;  ///< For generated classes, and that of all known at run time.
    Cache m_byKey;   ///< For all others.
};
}  // namespace tarn::kiln::internal
