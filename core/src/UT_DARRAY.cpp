// UT_DARRAY: storage, growth and element addresses.
#include "UT_DARRAY.h"

#include <climits>
#include <cstdlib>
#include <cstring>

UT_DARRAY::UT_DARRAY(void* storagePointer, int elementWidth, int initialCapacity, int clearNew)
    : m_storagePointer(storagePointer),
      m_width(elementWidth > 0 ? elementWidth : 1),
      m_initialCapacity(initialCapacity > 0 ? initialCapacity : 1),
      m_clearNew(clearNew != 0)
{
    PublishStorage();
}

UT_DARRAY::~UT_DARRAY()
{
    std::free(m_storage);
    m_storage = nullptr;
    PublishStorage();
}

void UT_DARRAY::PublishStorage()
{
    // The owner's pointer has the owner's element type; copying the bytes of
    // the address keeps the store free of type punning.
    if (m_storagePointer)
        std::memcpy(m_storagePointer, &m_storage, sizeof m_storage);
}

bool UT_DARRAY::Reserve(int capacity)
{
    if (capacity <= m_capacity)
        return true;
    int grown = m_capacity > 0 ? m_capacity : m_initialCapacity;
    while (grown < capacity)
        grown = grown > INT_MAX / 2 ? INT_MAX : grown * 2;
    const size_t bytes = static_cast<size_t>(grown) * static_cast<size_t>(m_width);
    char* storage = static_cast<char*>(std::realloc(m_storage, bytes));
    if (!storage)
        return false;
    m_storage = storage;
    m_capacity = grown;
    PublishStorage();
    return true;
}

void* UT_DARRAY::getaddr(int index)
{
    if (index < 0 || index > m_count)
        return nullptr;
    if (index == m_count && !a_resetnum(m_count + 1))
        return nullptr;
    return m_storage + static_cast<size_t>(index) * m_width;
}

bool UT_DARRAY::a_resetnum(int count)
{
    if (count < 0)
        count = 0;
    if (count > m_count) {
        if (count == INT_MAX || !Reserve(count))
            return false;
        char* added = m_storage + static_cast<size_t>(m_count) * m_width;
        if (m_clearNew)
            std::memset(added, 0, static_cast<size_t>(count - m_count) * m_width);
    }
    m_count = count;
    return true;
}
