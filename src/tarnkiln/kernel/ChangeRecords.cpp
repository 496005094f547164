#include "tarnkiln/kernel/ChangeRecords.h"

namespace tarn::kiln {

ChangeRecords::ChangeRecords() = default;
ChangeRecords::~ChangeRecords() = default;

ModelElement::Impl::Changes* ChangeRecords::findAnyTime(ModelElement::Impl const* element) const
{
    if (ModelElement::Impl::Changes* const own = find(element))
        return own;
    for (; m_filed < m_records.size(); ++m_filed)
    {
        if (ModelElement::Impl::Changes* const record = m_records[m_filed].get())
            m_byUuid.emplace(record->getUuid(), record);
    }
    ModelElement::Impl::Changes* first = nullptr;
    auto const [begin, end] = m_byUuid.equal_range(element->getUuid());
    for (auto found = begin; found != end; ++found)
    {
        if (found->second->isOf(element))
            return found->second;
        if (!first || !found->second->isCreated())
            first = found->second;
    }
    return first;
}

void ChangeRecords::append(ModelElement::Impl* element, ChangesHolder record)
{
    m_records.push_back(std::move(record));
    element->m_recordPlace = static_cast<std::uint32_t>(m_records.size() - 1);
}

void ChangeRecords::forget(ModelElement::Impl const* element)
{
    if (!find(element))
        return;
    m_byUuid.clear();
    m_filed = 0;
    m_records[element->m_recordPlace] = ChangesHolder();
}
}  // namespace tarn::kiln
