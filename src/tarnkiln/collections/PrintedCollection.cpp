// How collections are shown to people.
#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/collections/StringToStringMap.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/streamText.h"

#include <map>

namespace tarn::kiln {

std::ostream& operator<<(std::ostream& out, AbstractOwnedCollection const& collection)
{
    using internal::streamEntries;
    if (auto const* const references = dynamic_cast<ReferenceCollection const*>(&collection))
        streamEntries(out, references->getAllValuesAndProxies(),
                      [&](ModelElement const& entry) { out << entry; });
    else if (auto const* const values =
                 dynamic_cast<AbstractPrimitiveCollection const*>(&collection))
        streamEntries(out, values->getAllValues(),
                      [&](Value const& entry) { internal::streamContents(out, entry); });
    else if (auto const* const texts = dynamic_cast<StringToStringMap const*>(&collection))
        streamEntries(out, std::multimap<ustring, ustring>(texts->begin(), texts->end()),
                      [&](auto const& entry) {
                          internal::streamQuoted(out, entry.first);
                          out << ": ";
                          internal::streamQuoted(out, entry.second);
                      });
    return out;
}
}  // namespace tarn::kiln
