#include "tarnkiln/kernel/ElementImpl.h"

#include <boost/random/mersenne_twister.hpp>
#include <boost/random/uniform_int_distribution.hpp>

#include <array>
#include <cstdint>
#include <random>
#include <vector>

namespace tarn::kiln {

namespace {

/// How many deletions may be under way inside one another before further ones wait.
constexpr int MAX_DELETION_DEPTH = 32;

/// The deletions of one thread that are under way, and those that wait for the outermost.
struct Deletions
{
    int depth = 0;
    std::vector<ElementImpl*> waiting;
};

thread_local Deletions deletions;

boost::random::mt19937 seededGenerator()
{
    std::random_device device; // Boost's would be the one thing for which we need its library
    std::array<std::uint32_t, boost::random::mt19937::state_size> words;
    for (std::uint32_t& word : words)
        word = device();
    auto first = words.begin();
    return boost::random::mt19937(first, words.end());
}

} // namespace

ElementImpl::InvalidateCallback ElementImpl::m_callback = nullptr;

ElementImpl::ElementImpl(UUID const& id, ElementValidity validity)
    : m_uuid(id.is_nil() ? generateNewUuid() : id)
    , m_validity(validity)
{
}

ElementImpl::~ElementImpl() = default;

void ElementImpl::removeRef()
{
    if (m_refCount.fetch_sub(1) == 1)
        deleteThis();
}

void ElementImpl::deleteThis()
{
    if (deletions.depth == MAX_DELETION_DEPTH) {
        deletions.waiting.push_back(this);
        return;
    }
    ++deletions.depth;
    delete this;
    if (deletions.depth == 1) {
        while (!deletions.waiting.empty()) {
            ElementImpl* const next = deletions.waiting.back();
            deletions.waiting.pop_back();
            delete next;
        }
    }
    --deletions.depth;
}

void ElementImpl::invalidate()
{
    m_validity = ElementValidity::Invalid;
    if (m_callback)
        m_callback(this, nullptr);
}

void ElementImpl::setInvalidateCallback(InvalidateCallback callback)
{
    if (!m_callback)
        m_callback = callback;
}

UUID ElementImpl::generateNewUuid()
{
    thread_local boost::random::mt19937 generator = seededGenerator();
    boost::random::uniform_int_distribution<std::uint64_t> anyWord;

    UUID result;
    for (int half = 0; half < 2; ++half) {
        std::uint64_t word = anyWord(generator);
        for (int byte = 0; byte < 8; ++byte, word >>= 8)
            result.data[half * 8 + byte] = static_cast<std::uint8_t>(word);
    }
    result.data[8] = static_cast<std::uint8_t>((result.data[8] & 0x3F) | 0x80);
    result.data[6] = static_cast<std::uint8_t>((result.data[6] & 0x0F) | 0x40);
    return result;
}
} // namespace tarn::kiln
