#pragma once
/// @file
/// CDorArray, the growable array that every record of the library holds its lists in.
#include <cassert>
#include <climits>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <new>
#include <type_traits>

/// The growable array of the foundation library: TYPE elements, taken by ARG_TYPE (`T&` or `T`
/// as instantiated). The array owns its elements and their storage.
///
/// Storage rules that callers rely on:
/// - new elements are zero-filled and then default-constructed;
/// - growing relocates elements bitwise (never copy-constructs them), so an element must not
///   hold a pointer into itself, and pointers to elements are invalid after any growth;
/// - the automatic growth step is size/8 clamped to 4..1024, and a grown array holds
///   max(newSize, maxSize + step) elements (GrownCapacity).
///
/// Indexed access is bounds-checked in debug builds only. A failed allocation throws
/// std::bad_alloc. Not thread-safe; the library never shares one array between threads.
template <class TYPE, class ARG_TYPE = const TYPE&>
class CDorArray {
public:
    TYPE* data;   ///< Element storage; null when the array has no storage.
    int size;     ///< Elements in use.
    int maxSize;  ///< Elements allocated.
    int growBy;   ///< Growth step; 0 = automatic.

    /// An empty array with no storage and automatic growth.
    CDorArray() : data(nullptr), size(0), maxSize(0), growBy(0) {}
    /// A deep copy: sized to other's count, then element-wise assignment.
    CDorArray(const CDorArray& other) : data(nullptr), size(0), maxSize(0), growBy(0) { CopyFrom(other); }
    /// Sizes to other's count (keeping the growth step) and assigns element by element.
    CDorArray& operator=(const CDorArray& other)
    {
        if (this != &other)
            CopyFrom(other);
        return *this;
    }
    /// Destroys every element and frees the storage.
    ~CDorArray() { SetSize(0); }

    /// The number of elements in use.
    int GetSize() const { return size; }
    /// The element storage (null when empty); valid until the array next grows or empties.
    TYPE* GetData() { return data; }
    /// @copydoc GetData()
    const TYPE* GetData() const { return data; }

    /// Element i, 0 <= i < GetSize(); not checked in release builds.
    TYPE& operator[](int i)
    {
        assert(i >= 0 && i < size);
        return data[i];
    }
    /// @copydoc operator[](int)
    const TYPE& operator[](int i) const
    {
        assert(i >= 0 && i < size);
        return data[i];
    }

    /// Destroys every element and frees the storage; the same as SetSize(0).
    void RemoveAll() { SetSize(0); }

    /// Resizes to newSize elements: 0 (or below) destroys every element and frees the storage;
    /// growing zero-fills and default-constructs the new elements, relocating the old ones
    /// bitwise when the capacity runs out; shrinking destroys the surplus and keeps the storage.
    /// newGrowBy other than -1 replaces the growth step first.
    void SetSize(int newSize, int newGrowBy = -1) { Resize(newSize, newGrowBy, true); }

    /// Stores a copy of element at index (0 or more), growing the array first when index is past
    /// the end. element may be one of this array's own elements. Index INT_MAX, which would need
    /// more elements than an int counts, fails as an allocation does (std::bad_alloc, the array
    /// unchanged).
    void SetAtGrow(int index, ARG_TYPE element)
    {
        assert(index >= 0);
        if (index < size) {
            data[index] = element;
            return;
        }
        if (index == INT_MAX)
            throw std::bad_alloc();
        if (Holds(&element)) {  // growing would move the source out from under us
            TYPE copy(element);
            SetAtGrow(index, copy);
            return;
        }
        if constexpr (std::is_trivially_copyable<TYPE>::value) {
            // Zero-fill, construct and assign end with the source's bytes: write them directly.
            int old = size;
            Resize(index + 1, -1, false);
            ConstructRange(old, index);
            std::memcpy(static_cast<void*>(data + index), static_cast<const void*>(&element), sizeof(TYPE));
        } else {
            SetSize(index + 1);
            data[index] = element;
        }
    }

    /// Appends a copy of element (growing by the rule above) and returns its index.
    int Add(ARG_TYPE element)
    {
        int index = size;
        SetAtGrow(index, element);
        return index;
    }

    /// The capacity that growing from maxSize elements to newSize (> maxSize) gives: the larger of
    /// newSize and maxSize + step, where step is growBy, or size / 8 clamped to 4..1024 when growBy
    /// is 0. Capped at INT_MAX rather than overflowing.
    static int GrownCapacity(int size, int maxSize, int growBy, int newSize)
    {
        long long step = growBy;
        if (step == 0)
            step = size / 8 < 4 ? 4 : (size / 8 > 1024 ? 1024 : size / 8);
        long long grown = maxSize + step;
        return grown > newSize ? static_cast<int>(grown < INT_MAX ? grown : INT_MAX) : newSize;
    }

private:
    bool Holds(const void* p) const
    {
        const char* c = static_cast<const char*>(p);
        const char* begin = reinterpret_cast<const char*>(data);
        return data && c >= begin && c < begin + sizeof(TYPE) * static_cast<size_t>(maxSize);
    }

    void ConstructRange(int from, int to)
    {
        if (to <= from)
            return;
        std::memset(static_cast<void*>(data + from), 0, sizeof(TYPE) * static_cast<size_t>(to - from));
        for (int i = from; i < to; ++i)
            ::new (static_cast<void*>(data + i)) TYPE();
    }

    void DestroyRange(int from, int to)
    {
        if constexpr (!std::is_trivially_destructible<TYPE>::value) {
            for (int i = from; i < to; ++i)
                data[i].~TYPE();
        }
    }

    static TYPE* Reallocate(TYPE* old, int count)
    {
        // NOTE: realloc is the bitwise relocation the growth rule asks for; for large blocks the C
        // runtime can move pages instead of bytes, which keeps the fixed 1024-element step cheap.
        if (static_cast<size_t>(count) > SIZE_MAX / sizeof(TYPE))  // 32-bit targets
            throw std::bad_alloc();
        void* p = std::realloc(static_cast<void*>(old), sizeof(TYPE) * static_cast<size_t>(count));
        if (!p)
            throw std::bad_alloc();
        return static_cast<TYPE*>(p);
    }

    void Resize(int newSize, int newGrowBy, bool construct)
    {
        if (newGrowBy != -1)
            growBy = newGrowBy;
        if (newSize <= 0) {
            DestroyRange(0, size);
            std::free(static_cast<void*>(data));
            data = nullptr;
            size = maxSize = 0;
            return;
        }
        if (!data) {
            data = Reallocate(nullptr, newSize);
            if (construct)
                ConstructRange(0, newSize);
            size = maxSize = newSize;
            return;
        }
        if (newSize <= maxSize) {
            if (newSize > size) {
                if (construct)
                    ConstructRange(size, newSize);
            } else {
                DestroyRange(newSize, size);
            }
            size = newSize;
            return;
        }
        int newMax = GrownCapacity(size, maxSize, growBy, newSize);
        data = Reallocate(data, newMax);
        if (construct)
            ConstructRange(size, newSize);
        size = newSize;
        maxSize = newMax;
    }

    // SetSize to the source's count, then element-wise assignment.
    void CopyFrom(const CDorArray& other)
    {
        if constexpr (std::is_trivially_copyable<TYPE>::value) {
            // Same bytes as construct-then-assign, written once.
            Resize(other.size, -1, false);
            if (size > 0)
                std::memcpy(static_cast<void*>(data), static_cast<const void*>(other.data),
                            sizeof(TYPE) * static_cast<size_t>(size));
        } else {
            SetSize(other.size);
            for (int i = 0; i < size; ++i)
                data[i] = other.data[i];
        }
    }
};
