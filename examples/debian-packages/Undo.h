/// \file
/// Takes a committed transaction back by another one.
#pragma once
#include "tarnkiln/kernel/ReportData.h"

namespace debian {

/// Makes the model of the report what it was before the transaction, if nothing changed since.
///
/// What was destroyed is made anew: elements of the same classes with the same UUIDs and values,
/// but other objects; handles to the destroyed ones stay dead. Single references that still lead to
/// a destroyed element of this model lead to the new one afterwards. What was created is
/// destroyed. It knows no class of elements: all goes through reflection.
///
/// Not for transactions that set plain values of elements and then destroyed them, since a
/// report does not tell which plain values of a destroyed element had changed.
///
/// \param report  of a deep transaction.
/// \throws std::runtime_error  if a listener refuses; the model is then as it was before the call.
void undo(tarn::kiln::ReportData const& report);

}  // namespace debian
