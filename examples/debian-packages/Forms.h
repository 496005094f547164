/// \file
/// The two forms in which the elements of an index come.
///
///     template <ElementForm Form> void print(Package<Form> const& package)
///     {
///         for (auto const& release : members(package->getReleases()))
///             std::cout << textOf<Form>(release) << '\n';
///     }
#pragma once
#include "model/AlternativeImpl.h"
#include "model/DependencyGroupImpl.h"
#include "model/PackageImpl.h"
#include "model/PackageIndexImpl.h"
#include "model/ReleaseImpl.h"
#include "reflective/Elements.h"

#include <concepts>
#include <ranges>
#include <vector>

namespace debian {

/// Elements whose classes are generated from `model/debian.json`.
struct Generated
{
    using PackageIndex = model::PackageIndex;
    using Package = model::Package;
    using Release = model::Release;
    using DependencyGroup = model::DependencyGroup;
    using Alternative = model::Alternative;
};

/// Elements whose classes are defined at run time and reached through `Value`.
struct Reflective
{
    using PackageIndex = reflective::PackageIndex;
    using Package = reflective::Package;
    using Release = reflective::Release;
    using DependencyGroup = reflective::DependencyGroup;
    using Alternative = reflective::Alternative;
};

template <class Handle>
concept HandleOfElement = std::derived_from<Handle, tarn::kiln::ModelElement> &&
    requires(tarn::kiln::Model const& model, tarn::kiln::ModelElement const& element)
{
    // clang-format off
    { Handle::metaClass() } -> std::convertible_to<tarn::kiln::meta::Class>;
    { Handle::create(model) } -> std::same_as<Handle>;
    { Handle::cast(element) } -> std::same_as<Handle>;
    // clang-format on
};

/// What the program is written for: handles of five classes, whose properties go by the names that
/// generated code gives them.
template <class Form>
concept ElementForm = HandleOfElement<typename Form::PackageIndex> &&
    HandleOfElement<typename Form::Package> && HandleOfElement<typename Form::Release> &&
    HandleOfElement<typename Form::DependencyGroup> && HandleOfElement<typename Form::Alternative>;

template <ElementForm Form> using PackageIndex = typename Form::PackageIndex;
template <ElementForm Form> using Package = typename Form::Package;
template <ElementForm Form> using Release = typename Form::Release;
template <ElementForm Form> using DependencyGroup = typename Form::DependencyGroup;
template <ElementForm Form> using Alternative = typename Form::Alternative;

/// Expands `MACRO` once for each form, for sources that instantiate their templates.
#define DEBIAN_FOR_EACH_FORM(MACRO) MACRO(Generated) MACRO(Reflective)

/// \name What a collection of either form holds, in its order, without keys
/// @{
template <class T>
tarn::kiln::ElementSequence<T> const& members(tarn::kiln::ElementSequence<T> const& sequence)
{
    return sequence;
}
template <class Key, class T> auto members(tarn::kiln::ElementMap<Key, T> const& map)
{
    return std::views::values(map);
}
template <class T> std::vector<T> members(reflective::CollectionView<T> const& collection)
{
    return collection.members();
}
/// @}

}  // namespace debian
