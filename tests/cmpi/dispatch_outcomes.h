// Drives a provider's dispatch function through every operation and every
// extrinsic method of its class, and compares each answer with the outcome
// that dispatch_outcomes.txt records for it. The providers run in this
// process, linked as in the module, on the simulated adapter library, with a
// private HOME whose log tells which calls reached a provider.
#ifndef _VSPR_cmpi_dispatch_outcomes_h
#define _VSPR_cmpi_dispatch_outcomes_h

#include <gtest/gtest.h>
#include <cstdlib>
#include <fstream>
#include <map>
#include <set>
#include <sstream>
#include <string>
#include <vector>

#include "Instance.h"
#include "Provider_Status.h"
#include "Registration.h"
#include "String.h"
#include "TestSupport.h"

namespace dispatch_test
{

using namespace OLMA;

// One provider as the generator knows it.
struct Case
{
    const char* provider;
    Provider_Proc proc;
    std::vector<const char*> methods;
};

inline std::ostream& operator<<(std::ostream& os, const Case& c)
{
    return os << c.provider;
}

// The operations in the order they are called, then the methods.
inline const std::vector<std::string>& operations()
{
    static const std::vector<std::string> ops = { "load", "get_instance", "enum_instances",
        "create_instance", "delete_instance", "modify_instance", "enum_associator_names",
        "enum_references", "enum_associators", "enable_indications", "disable_indications",
        "unload" };
    return ops;
}

// provider -> operation or method -> outcome: a status, or "provider".
typedef std::map<std::string, std::map<std::string, std::string> > Table;

inline const Table& outcomes()
{
    static const Table table = []
    {
        Table t;
        std::ifstream in(VSPR_SOURCE_DIR "/tests/cmpi/dispatch_outcomes.txt");
        EXPECT_TRUE(in.good()) << "dispatch_outcomes.txt not found";
        std::string line;
        while (std::getline(in, line))
        {
            if (line.empty() || line[0] == '#')
                continue;
            std::istringstream fields(line);
            std::string provider, call, outcome;
            if (!(fields >> provider >> call >> outcome))
            {
                ADD_FAILURE() << "bad line: " << line;
                continue;
            }
            EXPECT_TRUE(t[provider].emplace(call, outcome).second) << "twice: " << line;
        }
        return t;
    }();
    return table;
}

// What a provider sent to a handler.
struct Stream
{
    unsigned delivered = 0;
    bool ended = false;

    template<class STATUS>
    static bool proc(Instance* instance, STATUS, void* data)
    {
        return ((Stream*)data)->take(instance);
    }

    static bool indication_proc(Instance* instance, void* data)
    {
        return ((Stream*)data)->take(instance);
    }

    bool take(Instance* instance)
    {
        if (!instance)
        {
            ended = true;
            return false;
        }
        delivered++;
        unref(instance);
        return true;
    }
};

class Calls
{
public:

    explicit Calls(const Case& c) : _case(c)
    {
        // Moves the log to a private HOME before the first call.
        adapter_test::InProcessLog::path();
        sint32 status = c.proc(0, OP_GET_META_CLASS, &_meta_class, 0, 0, 0, 0, 0, 0, 0);
        EXPECT_EQ(0, status);
        status = c.proc(0, OP_CREATE_PROVIDER, &_provider, 0, 0, 0, 0, 0, 0, 0);
        EXPECT_EQ(0, status);
        Table::const_iterator i = outcomes().find(c.provider);
        if (i != outcomes().end())
            _rows = i->second;
    }

    ~Calls()
    {
        _case.proc(0, OP_DESTROY_PROVIDER, _provider, 0, 0, 0, 0, 0, 0, 0);
    }

    void all()
    {
        ASSERT_TRUE(_meta_class && _provider);
        for (const std::string& op : operations())
            operation(op);
        for (const char* m : _case.methods)
            method(m);
        for (const auto& row : _rows)
            ADD_FAILURE() << _case.provider << " " << row.first << ": a row for a call it doesn't have";
    }

private:

    // The status, and whether the call was seen to reach provider code.
    struct Answer
    {
        sint32 status;
        bool reached;
        Stream stream;
    };

    void operation(const std::string& op)
    {
        if (op == "disable_indications")
            return; // checked with enable_indications

        Instance* model = create(_meta_class, false);
        adapter_test::InProcessLog log;
        Answer a = { -1, false, Stream() };
        String empty;

        if (op == "load" || op == "unload")
        {
            a.status = _call(op == "load" ? OP_LOAD : OP_UNLOAD);
            a.reached = _entered(log, op);
        }
        else if (op == "get_instance")
        {
            Instance* instance = 0;
            a.status = _call(OP_GET_INSTANCE, model, &instance);
            a.reached = _past(a.status, GET_INSTANCE_UNSUPPORTED);
            if (instance)
                unref(instance);
        }
        else if (op == "enum_instances")
        {
            a.status = _call(OP_ENUM_INSTANCES, model,
                (void*)&Stream::proc<Enum_Instances_Status>, &a.stream);
            a.reached = _entered(log, op);
        }
        else if (op == "create_instance")
        {
            a.status = _call(OP_CREATE_INSTANCE, model);
            a.reached = _past(a.status, CREATE_INSTANCE_UNSUPPORTED);
        }
        else if (op == "delete_instance")
        {
            a.status = _call(OP_DELETE_INSTANCE, model);
            a.reached = _past(a.status, DELETE_INSTANCE_UNSUPPORTED);
        }
        else if (op == "modify_instance")
        {
            a.status = _call(OP_MODIFY_INSTANCE, model, model);
            a.reached = _past(a.status, MODIFY_INSTANCE_UNSUPPORTED);
        }
        else if (op == "enum_associator_names")
        {
            a.status = _call(OP_ENUM_ASSOCIATOR_NAMES, model, &empty, &empty, &empty,
                (void*)&Stream::proc<Enum_Associator_Names_Status>, &a.stream);
            a.reached = _past(a.status, ENUM_ASSOCIATOR_NAMES_UNSUPPORTED);
        }
        else if (op == "enum_references")
        {
            a.status = _call(OP_ENUM_REFERENCES, model, model, &empty,
                (void*)&Stream::proc<Enum_References_Status>, &a.stream);
            a.reached = _past(a.status, ENUM_REFERENCES_UNSUPPORTED);
        }
        else if (op == "enum_associators")
        {
            a.status = _call(OP_ENUM_ASSOCIATORS, model, &empty, &empty, &empty,
                (void*)&Stream::proc<Enum_Associators_Status>, &a.stream);
            a.reached = _past(a.status, ENUM_ASSOCIATORS_UNSUPPORTED);
        }
        else if (op == "enable_indications")
        {
            // A provider that takes the handler ends its stream when it is
            // disabled: that end is what shows both calls reached it.
            a.status = _call(OP_ENABLE_INDICATIONS,
                (void*)&Stream::indication_proc, &a.stream);
            Answer d = { _call(OP_DISABLE_INDICATIONS), false, Stream() };
            a.reached = d.reached = a.stream.ended;
            _compare("disable_indications", d);
        }

        destroy(model);
        _compare(op, a);
    }

    void method(const char* name)
    {
        const Meta_Method* mm = find_method(_meta_class, name);
        ASSERT_TRUE(mm) << _case.provider << " has no method " << name;
        Instance* self = create(_meta_class, false);
        Instance* m = create(mm);
        Answer a = { _call(OP_INVOKE_METHOD, self, m), false, Stream() };
        a.reached = _past(a.status, INVOKE_METHOD_UNSUPPORTED);
        destroy(m);
        destroy(self);
        _compare(name, a);
    }

    void _compare(const std::string& call, const Answer& a)
    {
        std::map<std::string, std::string>::iterator row = _rows.find(call);
        if (row == _rows.end())
        {
            ADD_FAILURE() << _case.provider << " " << call << ": no row";
            return;
        }
        const std::string want = row->second;
        _rows.erase(row);

        if (want == "provider")
        {
            EXPECT_TRUE(a.reached) << _case.provider << " " << call
                << " didn't reach the provider (status " << a.status << ")";
            return;
        }

        EXPECT_EQ(std::atoi(want.c_str()), a.status) << _case.provider << " " << call;

        // An enumeration that the provider doesn't serve has no instances,
        // and its end still reaches the handler.
        if (call == "enum_instances" && a.status != -1)
        {
            EXPECT_EQ(0u, a.stream.delivered) << _case.provider;
            EXPECT_TRUE(a.stream.ended) << _case.provider;
        }
    }

    sint32 _call(int op, void* a1 = 0, void* a2 = 0, void* a3 = 0, void* a4 = 0,
        void* a5 = 0, void* a6 = 0)
    {
        return _case.proc(0, op, _provider, a1, a2, a3, a4, a5, a6, 0);
    }

    static bool _past(sint32 status, sint32 unsupported)
    {
        return status != unsupported && status != -1;
    }

    // Provider code logs the start of an operation; the dispatch function
    // logs nothing of its own.
    static bool _entered(const adapter_test::InProcessLog& log, const std::string& op)
    {
        return adapter_test::countLines(log.text(), { "Entering: " + op }) > 0;
    }

    const Case& _case;
    const Meta_Class* _meta_class = 0;
    void* _provider = 0;
    std::map<std::string, std::string> _rows;
};

} // namespace dispatch_test

#endif // _VSPR_cmpi_dispatch_outcomes_h
