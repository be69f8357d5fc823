#ifndef _VSPR_Associations_h
#define _VSPR_Associations_h

// What the association providers share. An association provider only
// enumerates: it fetches the instances of both ends from the facades, pairs
// them by its class's rule and hands each association to the handler. The
// bridge serves associators and references from that one list.
//
// Everything here is inline: the providers live in four subsystem
// libraries, and none of them should need another's archive to link.

#include <cctype>
#include <exception>
#include <string>
#include <unordered_map>
#include <vector>

#include "Array.h"
#include "FCHBAManager.h"
#include "HDRManager.h"
#include "Instance.h"
#include "InstanceDelivery.h"
#include "Provider.h"
#include "ProviderTypes.h"
#include "String.h"
#include "log.h"

namespace OLMA
{

// What a facade returned, owned for the length of one enumeration: the
// instances go with the list, whatever way the enumeration ends.
class Instance_List
{
public:

    Instance_List() { }
    explicit Instance_List(const Array<Instance*>& items) : _items(items) { }
    ~Instance_List() { destroyInstances(_items); }

    // Takes over the instances of more, after those held.
    void take(const Array<Instance*>& more) { _items.append(more); }

    size_t size() const { return _items.size(); }
    bool empty() const { return _items.size() == 0; }
    const Instance* operator[](size_t i) const { return _items[i]; }

    // The element as a T, or null if it is none (or of another class).
    template<class T>
    const T* get(size_t i) const
    {
        return checked_cast<T>(static_cast<const Instance*>(_items[i]));
    }

private:

    Array<Instance*> _items;

    Instance_List(const Instance_List&);
    Instance_List& operator=(const Instance_List&);
};

inline Array<Instance*> fetchInstances(classId_t id)
{
    return FCHBAManager::getFCHBAManager()->getInstances(id);
}

inline Array<Instance*> fetchTargetInstances(classId_t id)
{
    return HDRManager::getHDRManager()->getInstances(id);
}

// A text property's value; a null property reads as the empty text.
inline String textOf(const Property<String>& p)
{
    return p.null ? String() : p.value;
}

inline std::string lowerText(const char* text, size_t size)
{
    std::string s(text, size);
    for (char& c : s)
        c = (char)tolower((unsigned char)c);
    return s;
}

inline std::string lowerText(const String& text)
{
    return lowerText(text.c_str(), text.size());
}

// The positions of a list's instances by a text, without regard to case,
// each text's positions in the list's order: a search of the list for a
// value, first or all matches, without walking it once per value.
class Text_Index
{
public:

    void add(const String& text, size_t position)
    {
        _positions[lowerText(text)].push_back(position);
    }

    const std::vector<size_t>& find(const String& text) const
    {
        static const std::vector<size_t> none;
        auto at = _positions.find(lowerText(text));
        return at == _positions.end() ? none : at->second;
    }

private:

    std::unordered_map<std::string, std::vector<size_t> > _positions;
};

// Makes the instances of one association class and hands them to the
// enumeration's handler. The ends are cloned into the references, so an
// association owns its ends and the lists keep theirs.
class Association_Sender
{
public:

    template<class A>
    explicit Association_Sender(Enum_Instances_Handler<A>* handler) :
        _meta_class(&A::static_meta_class),
        _proc(handler ? handler->proc : 0),
        _client_data(handler ? handler->client_data : 0),
        _open(handler != 0),
        _sent(0),
        _place(0)
    {
    }

    // Sends the association of the ends, given in the order of the class's
    // references (a third for the class that has three). An end that its
    // reference can't hold makes no association, with an ERR line. False
    // once the handler wants no more; nothing is sent after that.
    bool send(const Instance* first, const Instance* second, const Instance* third = 0)
    {
        if (!_open)
            return false;

        const Instance* ends[3] = { first, second, third };
        size_t given = third ? 3 : 2;

        if (_sent == 0)
            TLOG(LL_DBG, "Building and returning association instances");

        Instance* association = create(_meta_class, true);
        size_t filled = 0;

        for (size_t i = 0; i < _meta_class->num_meta_features; i++)
        {
            const Meta_Feature* mf = _meta_class->meta_features[i];

            if (!(mf->flags & FLAG_REFERENCE) || ((const Meta_Reference*)mf)->subscript)
                continue;

            const Meta_Reference* mr = (const Meta_Reference*)mf;
            const Instance* end = filled < given ? ends[filled] : 0;

            if (!end || !end->meta_class || !is_subclass(mr->meta_class, end->meta_class))
            {
                TLOG(LL_ERR, "%s.%s can't refer to %s", _meta_class->name, mr->name,
                    end && end->meta_class ? end->meta_class->name : "nothing");
                destroy(association);
                return true;
            }

            Instance* copy = clone(end);

            if (_place)
                _place(copy, _request_name_space);

            *(Instance**)__slot(association, mr->offset) = copy;
            filled++;
        }

        if (filled != given)
        {
            TLOG(LL_ERR, "%s has %u references, not %u", _meta_class->name,
                (unsigned)filled, (unsigned)given);
            destroy(association);
            return true;
        }

        _sent++;
        _open = _proc(association, ENUM_INSTANCES_OK, _client_data);
        return _open;
    }

    // Lets place set the namespace of each end of later associations, made
    // for a request in requestNamespace. By default an end names none, which
    // stands for the request's.
    typedef void (*Place)(Instance* end, const String& requestNamespace);

    void placeEnds(Place place, const String& requestNamespace)
    {
        _place = place;
        _request_name_space = requestNamespace;
    }

    bool open() const { return _open; }
    size_t sent() const { return _sent; }

private:

    const Meta_Class* _meta_class;
    Enum_Instances_Handler<Instance>::Proc _proc;
    void* _client_data;
    bool _open;
    size_t _sent;
    Place _place;
    String _request_name_space;

    Association_Sender(const Association_Sender&);
    Association_Sender& operator=(const Association_Sender&);
};

// One instance with each instance of a list, in the list's order; the one
// is the first reference, or the second if oneFirst is false.
inline void sendOneWithEach(Association_Sender& out, const Instance* one,
    const Instance_List& each, bool oneFirst = true)
{
    for (size_t i = 0; i < each.size() && out.open(); i++)
    {
        if (oneFirst)
            out.send(one, each[i]);
        else
            out.send(each[i], one);
    }
}

// Pairs by matching values: for each instance of the outer list, the
// instances of the inner list whose text equals the outer one's, without
// regard to case; the first match only, or all in the inner list's order.
// The outer instance is the first reference unless outerFirst is false.
// O and I are the classes that declare the compared properties.
template<class O, class I>
void sendMatches(Association_Sender& out,
    const Instance_List& outer, Property<String> O::* outerText,
    const Instance_List& inner, Property<String> I::* innerText,
    bool all, bool outerFirst)
{
    Text_Index index;

    for (size_t i = 0; i < inner.size(); i++)
    {
        if (const I* x = inner.get<I>(i))
            index.add(textOf(x->*innerText), i);
    }

    for (size_t o = 0; o < outer.size() && out.open(); o++)
    {
        const O* x = outer.get<O>(o);

        if (!x)
            continue;

        const std::vector<size_t>& hits = index.find(textOf(x->*outerText));

        for (size_t h = 0; h < hits.size() && out.open(); h++)
        {
            if (outerFirst)
                out.send(outer[o], inner[hits[h]]);
            else
                out.send(inner[hits[h]], outer[o]);

            if (!all)
                break;
        }
    }
}

// The frame of every association's enumeration: its log lines, and any
// failure that escapes a helper turned into a failed enumeration with its
// reason in the log, so that the CIM server always gets an answer. The body
// takes the sender and returns the status.
template<class A, class Body>
Enum_Instances_Status enumAssociation(Enum_Instances_Handler<A>* handler, Body body)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Enum_Instances_Status status = ENUM_INSTANCES_FAILED;

    try
    {
        Association_Sender out(handler);
        status = body(out);
    }
    catch (const std::exception& e)
    {
        TLOG(LL_ERR, "%s: enumeration failed: %s", A::static_meta_class.name, e.what());
        status = ENUM_INSTANCES_FAILED;
    }
    catch (...)
    {
        TLOG(LL_ERR, "%s: enumeration failed", A::static_meta_class.name);
        status = ENUM_INSTANCES_FAILED;
    }

    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return status;
}

// The checks that come before pairing. exactlyOne fails with an ERR line
// unless the list has one instance; present logs the message at the level
// and fails if the list is empty.
inline bool exactlyOne(const Instance_List& list, const char* error)
{
    if (list.size() == 1)
        return true;

    TLOG(LL_ERR, "%s", error);
    return false;
}

inline bool present(const Instance_List& list, Log_Level level, const char* message)
{
    if (!list.empty())
        return true;

    TLOG(level, "%s", message);
    return false;
}

// The host with each instance of a class. The host always has its one
// instance; should it ever come without, the parts go with the first host
// there is, and the enumeration fails only when there is neither a host to
// count on nor a part to tie to it.
inline Enum_Instances_Status sendFirstSystemWithEach(Association_Sender& out, classId_t partId,
    const char* error)
{
    Instance_List systems(fetchInstances(ID_VESPERA_ComputerSystem));
    Instance_List parts(fetchInstances(partId));

    if (parts.empty())
    {
        if (systems.size() == 1)
            return ENUM_INSTANCES_OK;

        TLOG(LL_ERR, "%s", error);
        return ENUM_INSTANCES_FAILED;
    }

    if (systems.empty())
    {
        TLOG(LL_ERR, "%s", error);
        return ENUM_INSTANCES_OK;
    }

    sendOneWithEach(out, systems[0], parts);
    return ENUM_INSTANCES_OK;
}

} // namespace OLMA

#endif
