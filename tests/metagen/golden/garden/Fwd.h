// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// Names the types of `acme.garden` without defining them.
#pragma once
#include "tarnkiln/kernel/Fwd.h"
#include "tarnkiln/meta/Fwd.h"

namespace acme::garden {
// Generated code calls the types of the library by their own names.
using namespace tarn::kiln;

class Bed;
class Plant;
enum class Season : int;
class Size;
class Tree;
}  // namespace acme::garden
