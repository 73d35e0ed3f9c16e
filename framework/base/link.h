#pragma once

namespace Sarnik
{

template <class T> class CLinkList;

/// Makes its heir T a node of one doubly linked list; both ends are null while it is in none.
template <class T> class CLink
{
public:
    T *Next() const noexcept { return next; }
    T *Previous() const noexcept { return prev; }

protected:
    CLink() = default;
    CLink(const CLink &) = delete;
    CLink &operator=(const CLink &) = delete;
    ~CLink() = default;

private:
    friend class CLinkList<T>;
    T *prev = nullptr;
    T *next = nullptr;
};

/// Nodes in a row; owns none of them.
template <class T> class CLinkList
{
public:
    T *Head() const noexcept { return head; }
    T *Tail() const noexcept { return tail; }
    bool Empty() const noexcept { return head == nullptr; }

    /// The node is in no list.
    void PushHead(T &node) noexcept
    {
        ends(node).next = head;
        (head != nullptr ? ends(*head).prev : tail) = &node;
        head = &node;
    }
    void PushTail(T &node) noexcept
    {
        ends(node).prev = tail;
        (tail != nullptr ? ends(*tail).next : head) = &node;
        tail = &node;
    }
    /// The node is in this list.
    void Unlink(T &node) noexcept
    {
        CLink<T> &link = ends(node);
        (link.prev != nullptr ? ends(*link.prev).next : head) = link.next;
        (link.next != nullptr ? ends(*link.next).prev : tail) = link.prev;
        link.prev = link.next = nullptr;
    }

private:
    static CLink<T> &ends(T &node) noexcept { return node; }

    T *head = nullptr;
    T *tail = nullptr;
};

} // namespace Sarnik
