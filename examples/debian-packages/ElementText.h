/// \file
/// How elements of an index are shown to people.
#pragma once
#include "model/Alternative.h"
#include "model/DependencyGroup.h"
#include "model/Package.h"
#include "model/Release.h"
#include "tarnkiln/kernel/Fwd.h"

#include <string>

namespace debian {

/// \name Texts of elements
/// For handles that are not empty. An element that was destroyed has lost its references: with the
/// report of the transaction that destroyed it, `before`, its text is the one that it had.
/// @{
using Before = tarn::kiln::ReportData const*;

std::string textOf(model::Package const& package, Before before = nullptr);  ///< "gdb"
std::string textOf(model::Release const& release, Before before = nullptr);  ///< "gdb 13.1-3 amd64"
/// "libc6 (>= 2.36)"
std::string textOf(model::Alternative const& alternative, Before before = nullptr);
/// "Depends: default-mta | mail-agent"
std::string textOf(model::DependencyGroup const& group, Before before = nullptr);
/// One of the above, or the name of the class.
std::string textOf(tarn::kiln::ModelElement const& element, Before before = nullptr);
/// @}

}  // namespace debian
