/// \file
/// Lists whose members know their neighbours, so that nothing is allocated for them.
#pragma once

namespace tarn::kiln::internal {

template <class T> class LinkedList;

/// What a `T` that can be in a `LinkedList<T>` derives from; it is in one at most.
template <class T> class Linked
{
private:
    friend class LinkedList<T>;

    T* m_previous = nullptr;
    T* m_next = nullptr;
};

/// A list of objects that others own, and take out before they go.
///
/// Threads: one at a time.
template <class T> class LinkedList
{
public:
    LinkedList() = default;
    LinkedList(LinkedList const&) = delete;
    LinkedList& operator=(LinkedList const&) = delete;

    /// Null if there is none.
    T* first() const { return m_first; }
    /// Of a member: whether there is no other.
    bool isOnly(Linked<T> const& one) const { return m_first == &one && !one.m_next; }
    /// At the front; it is in no list.
    void insert(T& one)
    {
        Linked<T>& link = one;
        link.m_previous = nullptr;
        link.m_next = m_first;
        if (m_first)
            static_cast<Linked<T>&>(*m_first).m_previous = &one;
        m_first = &one;
    }
    /// A member.
    void erase(T& one)
    {
        Linked<T>& link = one;
        (link.m_previous ? static_cast<Linked<T>&>(*link.m_previous).m_next : m_first) =
            link.m_next;
        if (link.m_next)
            static_cast<Linked<T>&>(*link.m_next).m_previous = link.m_previous;
    }

private:
    T* m_first = nullptr;
};
}  // namespace tarn::kiln::internal
