/// \file
/// The names of this folder.
#pragma once

namespace tarn::kiln::query {
class AbstractQuery;
class NativeTarnkilnQuery;
class ReflectiveQuery;
class RetargetableQuery;
class ValueComparatorRegistry;
template <class... C> class Results;
enum class SearchClassMatchMode : int;
enum class ValueMatchRelation : int;
}  // namespace tarn::kiln::query
