#include "tarnkiln/kernel/internal/ModelName.h"

#include <algorithm>

namespace tarn::kiln::internal {

ModelNames::Handle ModelNames::get(ustring const& text)
{
    auto const known = std::find_if(m_recent.begin(), m_recent.end(),
                                    [&](Handle const& name) { return name.get()->text() == text; });
    if (known != m_recent.end())
        return *known;
    Handle const made(new ModelName(text));
    if (m_recent.size() < MOST)
    {
        m_recent.push_back(made);
        return made;
    }
    m_recent[m_next] = made;
    m_next = (m_next + 1) % MOST;
    return made;
}
}  // namespace tarn::kiln::internal
