#include "benchmarks/peers/tarnkiln/Workloads.h"

namespace peers {

Library& FullLibraries::ours()
{
    if (!m_ours)
        m_ours.emplace(m_size).fill();
    return *m_ours;
}

PlainLibrary& FullLibraries::plain()
{
    if (!m_plain)
        m_plain.emplace(Library::titles(m_size)).fill();
    return *m_plain;
}
}  // namespace peers
