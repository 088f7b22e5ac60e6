#pragma once

#include <algorithm>
#include <initializer_list>
#include <type_traits>
#include <utility>
#include <vector>

/// What both arrays share: a growing, contiguous sequence that owns its elements. Copies are deep.
/// Indices are ints from 0. Pointers and references to elements live until the array grows, is
/// destroyed or is assigned to.
///
/// @tparam T any copyable type but bool
template <class T> class KM_ArrayBase {
    static_assert(!std::is_same_v<T, bool>, "elements need addresses of their own");

public:
    KM_ArrayBase() = default;
    KM_ArrayBase(std::initializer_list<T> elements) : m_elements(elements) {}

    int Count() const { return static_cast<int>(m_elements.size()); }
    bool IsEmpty() const { return m_elements.empty(); }

    /// Sets the number of elements; new ones are value-initialised. A negative count is 0.
    void SetCount(int count) { m_elements.resize(Size(count)); }

    /// Makes room for `capacity` elements without changing the count; never shrinks.
    void Reserve(int capacity) { m_elements.reserve(Size(capacity)); }
    /// Number of elements for which there is room.
    int Capacity() const { return static_cast<int>(m_elements.capacity()); }

    /// Appends a copy; `element` may be one of this array's own.
    void Append(const T& element) { m_elements.push_back(element); }
    /// Appends copies of `count` elements, which may be this array's own. Nothing is appended when
    /// the pointer is null or the count is not positive.
    void Append(int count, const T* elements) {
        if (!elements || count <= 0)
            return;
        const std::vector<T> copies(elements, elements + count);
        m_elements.insert(m_elements.end(), copies.begin(), copies.end());
    }

    /// Inserts a copy before the element at `index`; an index outside [0, Count()] is moved to the
    /// nearer end.
    void Insert(int index, const T& element) {
        m_elements.insert(m_elements.begin() + std::clamp(index, 0, Count()), element);
    }

    /// Removes the element at `index`; an index outside the array changes nothing.
    void Remove(int index) {
        if (Has(index))
            m_elements.erase(m_elements.begin() + index);
    }

    /// Sets the count to 0 and keeps the storage.
    void Empty() { m_elements.clear(); }
    /// Sets the count to 0 and frees the storage.
    void Destroy() { std::vector<T>().swap(m_elements); }

    /// The element at `index`. The index must lie in [0, Count()): it is not checked. Where it
    /// comes from outside, use At.
    T& operator[](int index) { return m_elements[static_cast<std::size_t>(index)]; }
    const T& operator[](int index) const { return m_elements[static_cast<std::size_t>(index)]; }

    /// The element at `index`, or null when the index is outside the array.
    T* At(int index) { return Has(index) ? m_elements.data() + index : nullptr; }
    const T* At(int index) const { return Has(index) ? m_elements.data() + index : nullptr; }

    /// First and last element; null when the array is empty.
    T* First() { return At(0); }
    const T* First() const { return At(0); }
    T* Last() { return At(Count() - 1); }
    const T* Last() const { return At(Count() - 1); }

    /// The storage: Count() elements; may be null when the array is empty.
    T* Array() { return m_elements.data(); }
    const T* Array() const { return m_elements.data(); }

    /// Index of the first element equal to `element`, or -1.
    int Search(const T& element) const {
        const auto found = std::find(m_elements.begin(), m_elements.end(), element);
        return found == m_elements.end() ? -1 : static_cast<int>(found - m_elements.begin());
    }

    void Reverse() { std::reverse(m_elements.begin(), m_elements.end()); }

    T* begin() { return m_elements.data(); }
    T* end() { return m_elements.data() + m_elements.size(); }
    const T* begin() const { return m_elements.data(); }
    const T* end() const { return m_elements.data() + m_elements.size(); }

    /// Equal when both hold equal elements in the same order.
    friend bool operator==(const KM_ArrayBase& a, const KM_ArrayBase& b) {
        return a.m_elements == b.m_elements;
    }

protected:
    T& AddNew() { return m_elements.emplace_back(); }

private:
    static std::size_t Size(int count) { return static_cast<std::size_t>(std::max(count, 0)); }
    bool Has(int index) const { return index >= 0 && index < Count(); }

    std::vector<T> m_elements;
};

/// An array of plain values: numbers, pointers, points, identifiers.
template <class T> class KM_SimpleArray : public KM_ArrayBase<T> {
    static_assert(std::is_trivially_copyable_v<T>, "use KM_ClassArray for such elements");

public:
    using KM_ArrayBase<T>::KM_ArrayBase;

    /// Appends a value-initialised element and returns it.
    T& AppendNew() { return this->AddNew(); }
};

/// An array of objects with copy operations of their own, such as strings.
template <class T> class KM_ClassArray : public KM_ArrayBase<T> {
public:
    using KM_ArrayBase<T>::KM_ArrayBase;

    /// Appends a default-constructed element and returns it.
    T& AppendNew() { return this->AddNew(); }
};
