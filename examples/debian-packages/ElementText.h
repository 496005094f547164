/// \file
/// How elements of an index are shown to people.
#pragma once
#include "Forms.h"
#include "tarnkiln/kernel/Fwd.h"

#include <string>

namespace debian {
class MissingNames;

/// \name Texts of elements
/// For handles that are not empty. An element that was destroyed has lost its references: with the
/// report of the transaction that destroyed it, `before`, its text is the one that it had.
/// A package that is not in the file is called so, unless `missing` tells its name.
/// @{
using Before = tarn::kiln::ReportData const*;
using Missing = MissingNames const*;

/// "gdb"
template <ElementForm Form>
std::string textOf(Package<Form> const& package, Before before = nullptr,
                   Missing missing = nullptr);
/// "gdb 13.1-3 amd64"
template <ElementForm Form>
std::string textOf(Release<Form> const& release, Before before = nullptr);
/// "libc6 (>= 2.36)"
template <ElementForm Form>
std::string textOf(Alternative<Form> const& alternative, Before before = nullptr,
                   Missing missing = nullptr);
/// "Depends: default-mta | mail-agent"
template <ElementForm Form>
std::string textOf(DependencyGroup<Form> const& group, Before before = nullptr,
                   Missing missing = nullptr);
/// One of the above, or the name of the class.
template <ElementForm Form>
std::string textOf(tarn::kiln::ModelElement const& element, Before before = nullptr);
/// @}

}  // namespace debian
