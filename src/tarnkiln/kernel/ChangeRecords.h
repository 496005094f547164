/// \file
/// All that a transaction remembers.
#pragma once
#include "tarnkiln/kernel/ChangesHolder.h"
#include "tarnkiln/kernel/UUIDHasher.h"
#include "tarnkiln/support/BlockList.h"

#include <unordered_map>

namespace tarn::kiln {

/// The records of one transaction, in the order in which it came to the elements.
///
/// An element knows the place of the last record that was made for it, so that its transaction
/// finds the record without a search. Reports may ask later, when other transactions have changed
/// the element; for them the records are also found by UUID.
///
/// Threads: as the model.
class TARNKILN_EXPORT ChangeRecords
{
public:
    ChangeRecords();
    ChangeRecords(ChangeRecords const&) = delete;
    ChangeRecords& operator=(ChangeRecords const&) = delete;
    ~ChangeRecords();

    /// The record that this transaction made for `element` itself; null if there is none, or if a
    /// later transaction has made one for it.
    ModelElement::Impl::Changes* find(ModelElement::Impl const* element) const
    {
        std::uint32_t const place = element->m_recordPlace;
        if (place >= m_records.size() || !m_records[place])
            return nullptr;
        ModelElement::Impl::Changes* const record = m_records[place].get();
        return record->isOf(element) ? record : nullptr;
    }
    /// The record of `element` or, failing that, of the first element with its UUID; null if there
    /// is none.
    ModelElement::Impl::Changes* findAnyTime(ModelElement::Impl const* element) const;

    /// Takes in the record of an element that has none.
    void append(ModelElement::Impl* element, ChangesHolder record);
    /// Lets go of the record of `element`, if there is one.
    void forget(ModelElement::Impl const* element);

    /// Calls `visit(ModelElement::Impl::Changes&)` for each, the first one first. Records that are
    /// made meanwhile are visited too.
    template <class Visit> void forEach(Visit const& visit) const
    {
        for (std::size_t i = 0; i < m_records.size(); ++i)
        {
            if (i + AHEAD < m_records.size() && m_records[i + AHEAD])
                m_records[i + AHEAD]->prefetchElement();
            if (m_records[i])
                visit(*m_records[i]);
        }
    }
    /// The same, the last one first, as what was done is undone. No record may be made meanwhile.
    template <class Visit> void forEachBackward(Visit const& visit) const
    {
        for (std::size_t i = m_records.size(); i-- != 0;)
        {
            if (i >= AHEAD && m_records[i - AHEAD])
                m_records[i - AHEAD]->prefetchElement();
            if (m_records[i])
                visit(*m_records[i]);
        }
    }

private:
    /// So many records before its turn an element is fetched into the cache.
    static constexpr std::size_t AHEAD = 8;

    support::BlockList<ChangesHolder> m_records;  ///< Null where one was let go.
    /// Of the first so many records, by UUID; made when a report first needs it.
    mutable std::unordered_multimap<UUID, ModelElement::Impl::Changes*, internal::UUIDHasher>
        m_byUuid;
    mutable std::size_t m_filed = 0;
};
}  // namespace tarn::kiln
