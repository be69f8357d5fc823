#include "config.h"
#include <ctype.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include "Buffer.h"
#include "Strings.h"
#include "log.h"

namespace OLMA {

static const size_t _MIN_CAPACITY = 4096;

static size_t _round_up_pow_2(size_t n)
{
    if (n < _MIN_CAPACITY)
        return _MIN_CAPACITY;

    size_t p = _MIN_CAPACITY;

    while (p < n)
    {
        TESSEL_ASSERT(p <= (size_t)-1 / 2);
        p <<= 1;
    }

    return p;
}

// Capacity excludes the spare byte for the terminator.
static char* _realloc(char* data, size_t cap)
{
    TESSEL_ASSERT(cap < (size_t)-1);
    char* p = static_cast<char*>(realloc(data, cap + 1));
    TESSEL_ASSERT(p != 0);
    return p;
}

Buffer::Buffer(const Buffer& x) : _data(0), _size(0), _cap(0)
{
    append(x._data, x._size);
}

Buffer::~Buffer()
{
    free(_data);
}

Buffer& Buffer::operator=(const Buffer& x)
{
    if (&x != this)
    {
        _size = 0;
        append(x._data, x._size);
    }

    return *this;
}

void Buffer::reserve(size_t capacity)
{
    if (_cap >= capacity)
        return;

    _cap = capacity < _MIN_CAPACITY ? _MIN_CAPACITY : capacity;
    _data = _realloc(_data, _cap);
}

void Buffer::_grow()
{
    if (_cap)
        TESSEL_ASSERT(_cap <= (size_t)-1 / 2);

    _cap = _cap ? _cap * 2 : _MIN_CAPACITY;
    _data = _realloc(_data, _cap);
}

void Buffer::insert(size_t pos, const void* data, size_t size)
{
    if (size == 0)
        return;

    if (pos > _size)
        pos = _size;

    if (_size + size > _cap)
    {
        // A fresh block: head, insert, tail; data may lie in the old one.
        size_t cap = _round_up_pow_2(_size + size);
        char* p = static_cast<char*>(malloc(cap + 1));
        TESSEL_ASSERT(p != 0);
        if (pos)
            memcpy(p, _data, pos);
        memcpy(p + pos, data, size);
        if (_size > pos)
            memcpy(p + pos + size, _data + pos, _size - pos);
        free(_data);
        _data = p;
        _cap = cap;
        _size += size;
        return;
    }

    // Moving the tail would shift the source too if it lies in it.
    const char* src = static_cast<const char*>(data);
    char* tmp = 0;

    if (src >= _data && src < _data + _size)
    {
        tmp = static_cast<char*>(malloc(size));
        TESSEL_ASSERT(tmp != 0);
        memcpy(tmp, src, size);
        src = tmp;
    }

    memmove(_data + pos + size, _data + pos, _size - pos);
    memcpy(_data + pos, src, size);
    _size += size;
    free(tmp);
}

void Buffer::remove(size_t pos, size_t size)
{
    if (pos >= _size)
        return;

    if (size > _size - pos)
        size = _size - pos;

    memmove(_data + pos, _data + pos + size, _size - pos - size);
    _size -= size;
}

int Buffer::format(const char* fmt, ...)
{
    va_list ap;
    va_start(ap, fmt);
    int r = vformat(fmt, ap);
    va_end(ap);
    return r;
}

int Buffer::vformat(const char* fmt, va_list ap)
{
    if (!fmt)
        return -1;

    // A negative vsnprintf result (old C libraries on truncation) doubles
    // the space; past this bound it is taken as a real error.
    static const size_t _MAX_SPACE = (size_t)1 << 30;
    size_t space = 128;

    for (;;)
    {
        if (_size + space > _cap)
            reserve(_round_up_pow_2(_size + space));

        va_list aq;
        va_copy(aq, ap);
        int r = vsnprintf(_data + _size, space, fmt, aq);
        va_end(aq);

        if (r < 0)
        {
            if (space >= _MAX_SPACE)
                return -1;

            space *= 2;
        }
        else if ((size_t)r >= space)
            space = (size_t)r + 1;
        else
        {
            _size += (size_t)r;
            return r;
        }
    }
}

void Buffer::append_uint16(uint16 x)
{
    char buf[22];
    size_t n;
    const char* s = uint16_to_str(buf, x, n);
    append(s, n);
}

void Buffer::append_uint32(uint32 x)
{
    char buf[22];
    size_t n;
    const char* s = uint32_to_str(buf, x, n);
    append(s, n);
}

void Buffer::append_uint64(uint64 x)
{
    char buf[22];
    size_t n;
    const char* s = uint64_to_str(buf, x, n);
    append(s, n);
}

void Buffer::dump() const
{
    static const char _hex[] = "0123456789ABCDEF";

    for (size_t off = 0; off < _size; off += 16)
    {
        size_t n = _size - off < 16 ? _size - off : 16;
        // 64 columns; only an offset past 32 bits would run longer.
        char line[80];
        memset(line, ' ', 64);
        line[64] = '\0';
        line[0] = ' ';
        line[1] = '>';

        size_t col = 2;

        for (size_t i = 0; i < n; i++)
        {
            uint8 c = (uint8)_data[off + i];
            line[col++] = _hex[c >> 4];
            line[col++] = _hex[c & 0xF];

            // Groups of four, with no blank after the line's last group.
            if ((i + 1) % 4 == 0 && i + 1 < 16)
                col++;
        }

        line[col] = '<';

        for (size_t i = 0; i < n; i++)
        {
            uint8 c = (uint8)_data[off + i];
            line[39 + i] = isprint(c) ? (char)c : '.';
        }

        snprintf(line + 56, sizeof(line) - 56, "%08lX", (unsigned long)off);
        printf("%s\n", line);
    }
}

} // namespace OLMA
