#include "tarnkiln/kernel/ElementImpl.h"

#include <boost/random/mersenne_twister.hpp>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdint>
#include <cstring>
#include <memory>
#include <mutex>
#include <new>
#include <system_error>
#include <vector>

#include <unistd.h>

namespace tarn::kiln {

namespace {

/// How many deletions may be under way inside one another before further ones wait.
constexpr int MAX_DELETION_DEPTH = 32;

/// The deletions of one thread that are under way, and those that wait for the outermost.
struct Deletions
{
    int depth = 0;
    std::vector<ElementImpl*>* waiting = nullptr;  ///< Made when the first one waits.
};

/// Holds no object, so that it is found without a test whether it has been made.
constinit thread_local Deletions deletions;

/// A function of its own, so that they are found once: in a shared library that takes a call.
[[gnu::noinline]] Deletions& deletionsOfThread()
{
    return deletions;
}

/// Deletes what waits, and what comes to wait meanwhile.
void deleteWaiting(Deletions& all)
{
    std::unique_ptr<std::vector<ElementImpl*>> const waiting(all.waiting);
    while (!waiting->empty())
    {
        ElementImpl* const next = waiting->back();
        waiting->pop_back();
        delete next;
    }
    all.waiting = nullptr;
}

/// False if there is no memory for it, and what can't wait is deleted at once.
bool waitsForOutermost(Deletions& all, ElementImpl* element)
{
    try
    {
        if (!all.waiting)
            all.waiting = new std::vector<ElementImpl*>;
        all.waiting->push_back(element);
        return true;
    }
    catch (std::bad_alloc const&)
    {
        return false;
    }
}

/// All of the state from the system's source of randomness. `std::random_device` would ask the
/// processor for each word, which takes milliseconds on a virtual machine, and that in each thread.
using Generator = boost::random::mt19937_64;

Generator seededGenerator()
{
    std::array<std::uint32_t, 2 * Generator::state_size> words;
    constexpr std::size_t AT_ONCE = 64;  // no call may ask for more than 256 bytes
    for (std::size_t at = 0; at < words.size(); at += AT_ONCE)
    {
        std::size_t const count = std::min(AT_ONCE, words.size() - at);
        if (getentropy(&words[at], count * sizeof(std::uint32_t)) != 0)
            throw std::system_error(errno, std::generic_category(), "no seed for new UUIDs");
    }
    auto first = words.begin();
    return Generator(first, words.end());
}

/// A function of its own, so that it is found once for the two words of a UUID.
[[gnu::noinline]] Generator& generatorOfThread()
{
    thread_local Generator generator = seededGenerator();
    return generator;
}
}  // namespace

ElementImpl::InvalidateCallback ElementImpl::m_callback = nullptr;

ElementImpl::ElementImpl(UUID const& id, ElementValidity validity)
    : m_uuid(id.is_nil() ? generateNewUuid() : id),
      m_validity(validity)
{}

ElementImpl::~ElementImpl() = default;

void ElementImpl::removeRef()
{
    if (!isPermanent() && m_refCount.decrement())
        deleteThis();
}

void ElementImpl::deleteThis()
{
    Deletions& ofThread = deletionsOfThread();
    if (ofThread.depth >= MAX_DELETION_DEPTH && waitsForOutermost(ofThread, this))
        return;
    ++ofThread.depth;
    delete this;
    if (ofThread.depth == 1 && ofThread.waiting)
        deleteWaiting(ofThread);
    --ofThread.depth;
}

void ElementImpl::invalidate()
{
    m_validity = ElementValidity::Invalid;
    if (m_callback)
        m_callback(this, nullptr);
}

void ElementImpl::makePermanent()
{
    // Found from here, and so not taken for lost, when the process ends.
    static auto* const permanents = new std::vector<ElementImpl*>;
    static auto* const mutex = new std::mutex;

    std::lock_guard const lock(*mutex);
    if (isPermanent())
        return;
    permanents->push_back(this);
    m_refCount.increment();  // for those who count on meanwhile
    m_isPermanent.store(true, std::memory_order_relaxed);
}

void ElementImpl::setInvalidateCallback(InvalidateCallback callback)
{
    if (!m_callback)
        m_callback = callback;
}

UUID ElementImpl::generateNewUuid()
{
    Generator& generator = generatorOfThread();

    UUID result;
    for (int half = 0; half < 2; ++half)
    {
        std::uint64_t const word = generator();
        std::memcpy(&result.data[half * 8], &word, sizeof word);
    }
    result.data[8] = static_cast<std::uint8_t>((result.data[8] & 0x3F) | 0x80);
    result.data[6] = static_cast<std::uint8_t>((result.data[6] & 0x0F) | 0x40);
    return result;
}
}  // namespace tarn::kiln
