/// \file
/// The report of a transaction as a listener sees it that cares for one class.
#pragma once
#include "tarnkiln/kernel/ReportData.h"

#include <vector>

namespace tarn::kiln {

/// A view of a report that shows the elements of class `T` only. Holds no old values.
template <class T> class ShallowChangeReport
{
public:
    explicit ShallowChangeReport(ReportData const& data) : m_data(data) {}

    ReportData const& getData() const { return m_data; }
    std::vector<ModelElement> const& getCreated() const { return m_data.getCreated(); }
    std::vector<ModelElement> const& getChanged() const { return m_data.getChanged(); }
    std::vector<ModelElement> const& getDestroyed() const { return m_data.getDestroyed(); }

    /// Calls `functor(T)` for each element of class `T` in `list`, one of the three above.
    template <class Functor>
    void doProcess(Functor const& functor, std::vector<ModelElement> const& list) const
    {
        for (ModelElement const& element : list)
        {
            T const typed = T::cast(element);
            if (typed.getElementImpl())
                functor(typed);
        }
    }

private:
    ReportData const& m_data;
};
}  // namespace tarn::kiln
