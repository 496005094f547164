/// \file
/// Shows the report of a transaction, and keeps it.
#pragma once
#include "Forms.h"
#include "tarnkiln/kernel/ListenerHolder.h"

#include <cstddef>
#include <iosfwd>
#include <optional>

namespace debian {

/// Writes a line for each element that was changed or destroyed, with what it held before, until
/// `maxLines` are written; then how many there are of each class.
template <ElementForm Form>
void printReport(std::ostream& output, tarn::kiln::ReportData const& report, std::size_t maxLines);

/// A deep listener that keeps the report of the last transaction that was committed.
///
/// Threads: as the model.
class ChangeRecorder : public tarn::kiln::Listener
{
public:
    void transactionCommitted(tarn::kiln::ReportData& report) { m_last.emplace(report); }

    /// The last report; nothing before the first commit. Keeps the elements in memory that the
    /// transaction destroyed.
    std::optional<tarn::kiln::ReportData> const& last() const { return m_last; }

private:
    std::optional<tarn::kiln::ReportData> m_last;
};

}  // namespace debian
