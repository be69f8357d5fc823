#ifndef _OLMA_Buffer_h
#define _OLMA_Buffer_h

#include <stdarg.h>
#include <string.h>
#include "config.h"

namespace OLMA {

// A growable byte array for building text. A zeroed object is an empty
// buffer. One spare byte beyond the capacity is always allocated so that
// c_str() can terminate the text in place.
class Buffer
{
public:
    Buffer() : _data(0), _size(0), _cap(0) { }
    Buffer(const Buffer& x);
    ~Buffer();
    Buffer& operator=(const Buffer& x);

    size_t size() const { return _size; }
    size_t capacity() const { return _cap; }
    char* data() { return _data; }
    const char* data() const { return _data; }

    // The contents, zero-terminated in the spare byte ("" when empty).
    const char* c_str() const
    {
        if (!_data)
            return "";
        _data[_size] = '\0';
        return _data;
    }

    void clear() { _size = 0; }

    void reserve(size_t capacity);
    void insert(size_t pos, const void* data, size_t size);
    void remove(size_t pos, size_t size);

    void append(char c)
    {
        if (_size == _cap)
            _grow();
        _data[_size++] = c;
    }

    void append(const void* data, size_t size)
    {
        // Growing goes through insert, which copes with data that lies in
        // this very buffer.
        if (size > _cap - _size)
            insert(_size, data, size);
        else if (size)
        {
            memcpy(_data + _size, data, size);
            _size += size;
        }
    }

    void append(const char* str) { append(str, strlen(str)); }

    // printf-style text, appended. Result: the characters written, or -1.
    int format(const char* fmt, ...) __attribute__((format(printf, 2, 3)));
    int vformat(const char* fmt, va_list ap) __attribute__((format(printf, 2, 0)));

    // Decimal text, without a terminator.
    void append_uint16(uint16 x);
    void append_uint32(uint32 x);
    void append_uint64(uint64 x);

    // Hex and character dump to standard output, 16 bytes a line.
    void dump() const;

    char* _data;
    size_t _size;
    size_t _cap;

private:
    void _grow();
};

} // namespace OLMA

#endif /* _OLMA_Buffer_h */
