/// \file
/// What can be seen of the nodes of a model, as text.
#pragma once
#include "tarnkiln/kernel/ModelImpl.h"
#include "tests/support/NodeImpl.h"

#include <string>
#include <vector>

namespace testkit {

/// A line for each element of `model`, in the order of the lines. That of a node has its tag, by
/// which it must be unique, its values, its place, and its references in their order, sets and maps
/// sorted by tag. Others tell their place only.
std::vector<std::string> pictureOf(Model const& model);
}  // namespace testkit
