// cimhost: try a CMPI provider module from the command line, without a CIM
// server. Verbs follow the wbemcli client; see usage() for all of them.

#include <algorithm>
#include <chrono>
#include <csignal>
#include <ctime>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <iostream>
#include <string>
#include <thread>
#include <vector>

#include <json/json.h>

#include "cimhost.h"
#include "internal.h"

#ifdef CIMHOST_CLASSES
// A build of the command for another namespace's classes (the tests' own
// module) names them here.
namespace OLMA
{
namespace cimhost
{
extern const Class_Table CIMHOST_CLASSES;
}
} // namespace OLMA
#endif

using namespace OLMA::cimhost;

namespace
{

const char usage_text[] =
    "usage: cimhost [OPTIONS] VERB ARGS...\n"
    "\n"
    "Loads a CMPI provider module, as a CIM server would, and runs one operation\n"
    "on it. Paths are in the CIM text form NAMESPACE:CLASS.KEY=VALUE,...; string\n"
    "values are quoted, references are quoted paths.\n"
    "\n"
    "Verbs:\n"
    "  ei NS:CLASS           enumerate instances\n"
    "      cimhost ei root/vespera:VESPERA_FCPort\n"
    "  ein NS:CLASS          enumerate instance names (paths, one per line)\n"
    "      cimhost ein root/vespera:VESPERA_PortController\n"
    "  gi PATH               get one instance\n"
    "      cimhost gi 'root/vespera:VESPERA_FCPort.CreationClassName=\"VESPERA_FCPort\","
    "DeviceID=\"10000000C9A1B2C3\",SystemCreationClassName=\"VESPERA_ComputerSystem\","
    "SystemName=\"host1\"'\n"
    "  ai PATH               associators of an object\n"
    "      cimhost ai --assoc-class VESPERA_ControlledBy 'root/vespera:VESPERA_FCPort.DeviceID=\"x\"'\n"
    "  an PATH               associator names\n"
    "      cimhost an --result-class VESPERA_PortController 'root/vespera:VESPERA_FCPort.DeviceID=\"x\"'\n"
    "  ri PATH               references (association instances) of an object\n"
    "      cimhost ri --result-class VESPERA_ControlledBy --role Dependent 'root/vespera:...'\n"
    "  rn PATH               reference names\n"
    "      cimhost rn 'root/vespera:VESPERA_ComputerSystem.Name=\"host1\",CreationClassName=\"VESPERA_ComputerSystem\"'\n"
    "  cm PATH METHOD [NAME=VALUE ...]\n"
    "                        invoke a method; VALUE is TYPE:TEXT (TYPE one of boolean,\n"
    "                        uint8..uint64, sint8..sint64, real32, real64, char16, string,\n"
    "                        datetime, ref; TYPE[] for a comma-separated array) or plain\n"
    "                        TEXT when the method declares the parameter's type\n"
    "      cimhost cm 'root/vespera:VESPERA_FCPort.DeviceID=\"x\"' RequestStateChange RequestedState=uint16:3\n"
    "      cimhost cm 'root/vespera:VESPERA_AgentService.Name=\"a\"' executeMethod "
    "'request=string:{\"method\":\"discovery.getAdapters\",\"id\":1}'\n"
    "      cimhost cm PATH RequestStateChange 'Job=ref:root/vespera:VESPERA_ConcreteJob.InstanceID=\"j1\"'\n"
    "  listen NS:CLASS       subscribe to indications and print each as it arrives, an\n"
    "                        alert with a summary line first; --json streams them as\n"
    "                        the elements of one document\n"
    "      cimhost listen root/vespera:VESPERA_AlertIndication --seconds 30\n"
    "  session               read verbs from standard input, one a line, and answer\n"
    "                        each as the single command would, all in one process: a\n"
    "                        test started by one line can be polled by the next.\n"
    "                        Words are split as a shell splits them ('...', \"...\",\n"
    "                        backslash); a line may carry its own options but --module,\n"
    "                        --reg and --no-interop, which hold for the whole session.\n"
    "                        Blank lines and lines starting with # are skipped, and\n"
    "                        \"sleep SECONDS\" waits (fractions allowed). The exit status\n"
    "                        is the worst of the lines'.\n"
    "      printf '%s\\n' 'cm PATH RunDiagnostic ManagedElement=...' 'sleep 5' \\\n"
    "          'ei root/vespera:VESPERA_ConcreteJob' | cimhost session\n"
    "\n"
    "Options:\n"
    "  --module PATH         provider module to load (default: the built\n"
    "                        libvsprprovider_Module.so, else found along LD_LIBRARY_PATH)\n"
    "      cimhost --module ./libmyprov.so ei root/test:My_Class\n"
    "  --reg FILE            SFCB-style registration file (default: schema/vsprprovider.reg)\n"
    "      cimhost --reg my.reg ein root/test:My_Class\n"
    "  --json                print one JSON document (paths, typed properties, return\n"
    "                        value and out parameters) instead of text\n"
    "      cimhost --json ei root/vespera:VESPERA_FCPort\n"
    "  --props a,b           only these properties (ei, gi, ai, ri)\n"
    "      cimhost ei root/vespera:VESPERA_FCPort --props DeviceID,PortType\n"
    "  --assoc-class CLASS   association class filter (ai, an)\n"
    "  --result-class CLASS  class of the other end (ai, an), of the association (ri, rn)\n"
    "  --role NAME           the source object's role (ai, an, ri, rn)\n"
    "  --result-role NAME    the other end's role (ai, an)\n"
    "      cimhost an --role Dependent --result-role Antecedent PATH\n"
    "  --seconds N           how long listen waits (default 10; 0: until interrupted)\n"
    "      cimhost listen root/vespera:VESPERA_AlertIndication --seconds 5\n"
    "  --count N             listen stops after N indications\n"
    "      cimhost listen root/vespera:VESPERA_AlertIndication --seconds 0 --count 3\n"
    "  --no-interop          don't serve the interop namespace from the built-in object manager\n"
    "      cimhost --no-interop ei root/vespera:VESPERA_ObjectManager\n"
    "  --interop-namespace NS  the interop namespace (default root/PG_InterOp, as\n"
    "                        OpenPegasus; SFCB's is root/interop)\n"
    "      cimhost --interop-namespace root/interop ei root/vespera:VESPERA_Namespace\n"
    "  --pegasus-enumerations  hand back the instances of up-calls' enumerations as\n"
    "                        OpenPegasus does: marked null, with a good pointer\n"
    "  --help                this text\n"
    "\n"
    "Exit status: 0 success; 1 the operation failed (the CMPI return code's name is\n"
    "printed) or the module couldn't be loaded; 2 bad input.\n";

// The options that choose and load the module; a session sets them once.
const char* const session_wide[] = {"--module", "--reg", "--no-interop"};

struct Bad_Input
{
    std::string message;
};

[[noreturn]] void bad(const std::string& message)
{
    throw Bad_Input {message};
}

Json::Value json_of(const Value& v);

Json::Value json_of(const Instance& inst)
{
    Json::Value j(Json::objectValue);
    j["class"] = inst.class_name;
    j["path"] = inst.path.to_string();
    Json::Value props(Json::arrayValue);
    for (const Property& p : inst.properties)
    {
        Json::Value jp(Json::objectValue);
        jp["name"] = p.name;
        jp["type"] = type_name(p.value.type);
        jp["null"] = p.value.null;
        jp["value"] = json_of(p.value);
        props.append(jp);
    }
    j["properties"] = props;
    return j;
}

Json::Value json_of(const Value& v)
{
    if (v.null)
        return Json::Value();
    if (v.is_array())
    {
        Json::Value a(Json::arrayValue);
        for (const Value& e : v.elements)
            a.append(json_of(e));
        return a;
    }
    switch (v.type)
    {
    case CMPI_boolean: return Json::Value(v.num.boolean != 0);
    case CMPI_uint8: return Json::Value(Json::UInt(v.num.uint8));
    case CMPI_uint16: return Json::Value(Json::UInt(v.num.uint16));
    case CMPI_uint32: return Json::Value(Json::UInt(v.num.uint32));
    case CMPI_uint64: return Json::Value(Json::UInt64(v.num.uint64));
    case CMPI_sint8: return Json::Value(Json::Int(v.num.sint8));
    case CMPI_sint16: return Json::Value(Json::Int(v.num.sint16));
    case CMPI_sint32: return Json::Value(Json::Int(v.num.sint32));
    case CMPI_sint64: return Json::Value(Json::Int64(v.num.sint64));
    case CMPI_char16: return Json::Value(Json::UInt(v.num.char16));
    case CMPI_real32: return Json::Value(double(v.num.real32));
    case CMPI_real64: return Json::Value(v.num.real64);
    case CMPI_instance: return v.inst ? json_of(*v.inst) : Json::Value();
    default: return Json::Value(v.text());
    }
}

Json::Value json_typed(const Value& v)
{
    Json::Value j(Json::objectValue);
    j["type"] = type_name(v.type);
    j["null"] = v.null;
    j["value"] = json_of(v);
    return j;
}

struct Args
{
    std::string module, reg;
    bool json = false;
    bool interop = true;
    std::string interop_namespace = "root/PG_InterOp";
    bool pegasus_enumerations = false;
    std::string verb;
    std::vector<std::string> positional;
    bool has_props = false;
    std::vector<std::string> props;
    std::string assoc_class, result_class, role, result_role;
    int seconds = 10;
    long count = 0;
};

std::vector<std::string> split_list(const std::string& s)
{
    std::vector<std::string> r;
    std::string cur;
    for (char c : s)
    {
        if (c == ',')
        {
            if (!cur.empty())
                r.push_back(cur);
            cur.clear();
        }
        else if (c != ' ')
            cur += c;
    }
    if (!cur.empty())
        r.push_back(cur);
    return r;
}

Args read_args(const std::vector<std::string>& argv)
{
    Args a;
    static const char* const valued[] = {"--module", "--reg", "--props", "--assoc-class",
                                         "--result-class", "--role", "--result-role", "--seconds",
                                         "--interop-namespace", "--count"};
    const size_t argc = argv.size();
    for (size_t i = 0; i < argc; i++)
    {
        std::string s = argv[i];
        std::string opt = s, val;
        bool inline_val = false;
        if (s.compare(0, 2, "--") == 0 && s.find('=') != std::string::npos)
        {
            opt = s.substr(0, s.find('='));
            val = s.substr(s.find('=') + 1);
            inline_val = true;
        }
        bool takes = false;
        for (const char* v : valued)
            takes = takes || opt == v;
        if (takes)
        {
            if (!inline_val)
            {
                if (i + 1 >= argc)
                    bad("option " + opt + " needs a value");
                val = argv[++i];
            }
            if (opt == "--module")
                a.module = val;
            else if (opt == "--reg")
                a.reg = val;
            else if (opt == "--props")
            {
                a.has_props = true;
                a.props = split_list(val);
            }
            else if (opt == "--assoc-class")
                a.assoc_class = val;
            else if (opt == "--result-class")
                a.result_class = val;
            else if (opt == "--role")
                a.role = val;
            else if (opt == "--result-role")
                a.result_role = val;
            else if (opt == "--interop-namespace")
                a.interop_namespace = val;
            else if (opt == "--count")
            {
                char* end = nullptr;
                long n = strtol(val.c_str(), &end, 10);
                if (val.empty() || *end || n < 1 || n > 1000000000)
                    bad("--count needs a number of indications, not '" + val + "'");
                a.count = n;
            }
            else
            {
                char* end = nullptr;
                long n = strtol(val.c_str(), &end, 10);
                if (val.empty() || *end || n < 0 || n > 86400)
                    bad("--seconds needs a number of seconds, not '" + val + "'");
                a.seconds = int(n);
            }
        }
        else if (s == "--json")
            a.json = true;
        else if (s == "--no-interop")
            a.interop = false;
        else if (s == "--pegasus-enumerations")
            a.pegasus_enumerations = true;
        else if (s.compare(0, 2, "--") == 0 && a.verb != "cm")
            bad("unknown option " + s);
        else if (a.verb.empty())
            a.verb = s;
        else
            a.positional.push_back(s);
    }
    return a;
}

Object_Path read_path(Host& host, const std::string& text, bool class_only)
{
    Object_Path p;
    std::string err;
    if (!host.parse_object_path(text, p, err))
        bad(err);
    if (class_only && !p.keys.empty())
        bad("'" + text + "' names an instance; give NAMESPACE:CLASS");
    return p;
}

void check_class(Host& host, const std::string& cls)
{
    if (!cls.empty() && !host.knows_class(cls))
        bad("unknown class " + cls);
}

Property read_arg(Host& host, const Object_Path& path, const std::string& method,
                  const std::string& text)
{
    Property p;
    std::string err;
    if (!host.parse_argument(path, method, text, p, err))
        bad(err);
    return p;
}

void print_text(const Result& r, const std::string& verb)
{
    for (const Instance& i : r.instances)
        std::cout << "// " << i.path.to_string() << "\n" << instance_mof(i) << ";\n\n";
    for (const Object_Path& p : r.paths)
        std::cout << p.to_string() << "\n";
    if (verb == "cm")
    {
        std::cout << "ReturnValue = " << r.return_value.text() << "\n";
        for (const Property& o : r.out)
        {
            if (!o.value.null && o.value.type == CMPI_instance && o.value.inst)
                std::cout << o.name << " =\n" << instance_mof(*o.value.inst, 4) << "\n";
            else
                std::cout << o.name << " = " << o.value.text() << "\n";
        }
    }
}

Json::Value json_result(const Result& r, const std::string& verb)
{
    Json::Value j(Json::objectValue);
    j["operation"] = verb;
    j["rc"] = int(r.rc);
    j["rc_name"] = rc_name(r.rc);
    j["message"] = r.message;
    if (verb == "ein" || verb == "an" || verb == "rn")
    {
        Json::Value paths(Json::arrayValue);
        for (const Object_Path& p : r.paths)
            paths.append(p.to_string());
        j["paths"] = paths;
    }
    else if (verb == "cm")
    {
        j["return_value"] = json_typed(r.return_value);
        Json::Value out(Json::arrayValue);
        for (const Property& o : r.out)
        {
            Json::Value jo = json_typed(o.value);
            jo["name"] = o.name;
            out.append(jo);
        }
        j["out"] = out;
    }
    else
    {
        Json::Value insts(Json::arrayValue);
        for (const Instance& i : r.instances)
            insts.append(json_of(i));
        j["instances"] = insts;
    }
    return j;
}

volatile sig_atomic_t interrupted = 0;

void on_interrupt(int)
{
    interrupted = 1;
}

// CIM_Indication's PerceivedSeverity values.
const char* severity_name(const Value* v)
{
    static const char* const names[] = {"Unknown", "Other", "Information", "Degraded/Warning",
                                        "Minor", "Major", "Critical", "Fatal/NonRecoverable"};
    if (!v || v->null || v->type != CMPI_uint16)
        return "no severity";
    return v->num.uint16 < sizeof(names) / sizeof(names[0]) ? names[v->num.uint16] : "DMTF Reserved";
}

std::string local_time_now()
{
    char text[32];
    time_t t = time(nullptr);
    struct tm tm;
    localtime_r(&t, &tm);
    strftime(text, sizeof(text), "%Y-%m-%d %H:%M:%S", &tm);
    return text;
}

// One indication as it arrives: where and when, for an alert what it says
// in one line, then all its properties.
void print_indication(const Host& host, const Indication_Record& rec, size_t number)
{
    const Instance& inst = rec.instance;
    std::cout << "// indication " << number << " in " << rec.name_space << " at "
              << local_time_now() << "\n";
    if (host.class_is_a(inst.class_name, "CIM_AlertIndication"))
    {
        std::string id = inst.get_text("MessageID");
        std::string element = inst.get_text("AlertingManagedElement");
        std::cout << "// alert " << inst.get_text("SequenceNumber") << ": "
                  << severity_name(inst.get("PerceivedSeverity"))
                  << (id.empty() ? "" : ", " + id) << ": " << inst.get_text("Message") << "\n";
        if (!element.empty() && element != "NULL")
            std::cout << "// at " << element << "\n";
    }
    std::cout << instance_mof(inst) << ";\n\n" << std::flush;
}

// Prints indications as they arrive until the time is up, the count is
// reached or the user interrupts; with --json they are the elements of one
// document, written as they come, so that the output is both a stream and
// valid JSON once complete.
int listen(Host& host, const Args& a)
{
    if (a.positional.size() != 1)
        bad("listen takes one NS:CLASS");
    Object_Path cls = read_path(host, a.positional[0], true);
    int id = 0;
    Result r = host.subscribe(cls.name_space, cls.class_name, id);
    if (!r.ok())
    {
        std::cerr << "cimhost: " << rc_name(r.rc) << (r.message.empty() ? "" : ": ")
                  << r.message << "\n";
        if (id)
            host.unsubscribe(id);
        return 1;
    }

    struct sigaction sa;
    memset(&sa, 0, sizeof(sa));
    sa.sa_handler = on_interrupt;
    sigaction(SIGINT, &sa, nullptr);
    sigaction(SIGTERM, &sa, nullptr);

    if (a.json)
        std::cout << "{\n\"operation\": \"listen\",\n\"indications\": [\n" << std::flush;
    else
        std::cout << "listening for " << cls.class_name << " in " << cls.name_space
                  << (a.seconds ? " for " + std::to_string(a.seconds) + " s" : " until interrupted")
                  << (a.count ? ", at most " + std::to_string(a.count) + " indications" : "")
                  << "\n" << std::flush;

    auto end = std::chrono::steady_clock::now() + std::chrono::seconds(a.seconds);
    size_t shown = 0;
    for (;;)
    {
        host.wait_indications(shown + 1, 200);
        std::vector<Indication_Record> inds = host.indications();
        for (; shown < inds.size() && (!a.count || long(shown) < a.count); shown++)
        {
            if (!a.json)
            {
                print_indication(host, inds[shown], shown + 1);
                continue;
            }
            Json::Value e(Json::objectValue);
            e["namespace"] = inds[shown].name_space;
            e["instance"] = json_of(inds[shown].instance);
            std::cout << (shown ? ",\n" : "") << Json::StyledWriter().write(e) << std::flush;
        }
        if (interrupted || (a.count && long(shown) >= a.count) ||
            (a.seconds && std::chrono::steady_clock::now() >= end))
            break;
    }

    Result u = host.unsubscribe(id);
    if (a.json)
    {
        Json::Value tail(Json::objectValue);
        tail["rc"] = int(u.rc);
        tail["rc_name"] = rc_name(u.rc);
        tail["message"] = u.message;
        std::string rest = Json::StyledWriter().write(tail);
        // The members of the tail, after the list: without its own braces.
        rest = rest.substr(rest.find('{') + 1);
        rest = rest.substr(0, rest.rfind('}'));
        std::cout << "],\n" << rest << "}\n" << std::flush;
    }
    if (!u.ok())
    {
        std::cerr << "cimhost: " << rc_name(u.rc) << (u.message.empty() ? "" : ": ")
                  << u.message << "\n";
        return 1;
    }
    return 0;
}

// A server logs what it refused a provider; the provider's results just
// lack it.
void warn_refusals(const Host& host)
{
    for (const std::string& line : host.refused_properties())
        std::cerr << "cimhost: warning: " << line << "\n";
}

void check_verb(const Args& a, bool in_session)
{
    static const char* const verbs[] = {"ei", "ein", "gi", "ai", "an", "ri", "rn", "cm", "listen",
                                        "session"};
    bool known = false;
    for (const char* v : verbs)
        known = known || a.verb == v;
    if (a.verb.empty())
        bad("no verb given (try --help)");
    if (!known || (in_session && a.verb == "session"))
        bad("unknown verb '" + a.verb + "' (try --help)");
}

// One verb on a loaded host, printed as the command prints it; its exit
// status. Bad input throws.
int execute(Host& host, const Args& a)
{
    if (a.verb == "listen")
    {
        int status = listen(host, a);
        warn_refusals(host);
        return status;
    }

    const std::vector<std::string>* props = a.has_props ? &a.props : nullptr;
    Result r;
    const std::string& v = a.verb;
    if (v == "cm")
    {
        if (a.positional.size() < 2)
            bad("cm takes PATH METHOD [NAME=VALUE ...]");
        Object_Path p = read_path(host, a.positional[0], false);
        std::vector<Property> in;
        for (size_t i = 2; i < a.positional.size(); i++)
            in.push_back(read_arg(host, p, a.positional[1], a.positional[i]));
        r = host.cm(p, a.positional[1], in);
    }
    else
    {
        if (a.positional.size() != 1)
            bad(v + " takes one " + (v == "ei" || v == "ein" ? "NS:CLASS" : "PATH"));
        bool class_only = v == "ei" || v == "ein";
        Object_Path p = read_path(host, a.positional[0], class_only);
        check_class(host, a.assoc_class);
        check_class(host, a.result_class);
        if (v == "ei")
            r = host.ei(p, props);
        else if (v == "ein")
            r = host.ein(p);
        else if (v == "gi")
            r = host.gi(p, props);
        else if (v == "ai")
            r = host.ai(p, a.assoc_class, a.result_class, a.role, a.result_role, props);
        else if (v == "an")
            r = host.an(p, a.assoc_class, a.result_class, a.role, a.result_role);
        else if (v == "ri")
            r = host.ri(p, a.result_class, a.role, props);
        else
            r = host.rn(p, a.result_class, a.role);
    }
    if (a.json)
        std::cout << Json::StyledWriter().write(json_result(r, v));
    else if (r.ok())
        print_text(r, v);
    warn_refusals(host);
    if (!r.ok())
    {
        std::cerr << "cimhost: " << rc_name(r.rc) << (r.message.empty() ? "" : ": ")
                  << r.message << "\n";
        return 1;
    }
    return 0;
}

// The words of a session line, split as a POSIX shell splits them: quotes
// group and are removed, a backslash takes the next character literally
// (inside double quotes only before $, `, ", \\ and a newline).
std::vector<std::string> split_words(const std::string& line)
{
    std::vector<std::string> words;
    std::string cur;
    bool have = false;
    for (size_t i = 0; i < line.size(); i++)
    {
        char c = line[i];
        if (c == ' ' || c == '\t' || c == '\r')
        {
            if (have)
                words.push_back(cur);
            cur.clear();
            have = false;
        }
        else if (c == '\'')
        {
            size_t end = line.find('\'', i + 1);
            if (end == std::string::npos)
                bad("unterminated ' in the line");
            cur += line.substr(i + 1, end - i - 1);
            have = true;
            i = end;
        }
        else if (c == '"')
        {
            have = true;
            for (i++;; i++)
            {
                if (i >= line.size())
                    bad("unterminated \" in the line");
                if (line[i] == '"')
                    break;
                if (line[i] == '\\' && i + 1 < line.size() &&
                    std::string("$`\"\\").find(line[i + 1]) != std::string::npos)
                    i++;
                cur += line[i];
            }
        }
        else if (c == '\\')
        {
            if (i + 1 < line.size())
                cur += line[++i];
            have = true;
        }
        else
        {
            cur += c;
            have = true;
        }
    }
    if (have)
        words.push_back(cur);
    return words;
}

// "sleep SECONDS", the one verb of a session alone.
void session_sleep(const std::vector<std::string>& words)
{
    char* end = nullptr;
    double seconds = words.size() == 2 ? strtod(words[1].c_str(), &end) : -1;
    if (words.size() != 2 || !end || *end || !(seconds >= 0) || seconds > 86400)
        bad("sleep takes a number of seconds");
    std::this_thread::sleep_for(std::chrono::duration<double>(seconds));
}

// Reads verbs from standard input until its end, on one host.
int session(Host& host)
{
    int worst = 0;
    std::string line;
    while (std::getline(std::cin, line))
    {
        size_t first = line.find_first_not_of(" \t\r");
        if (first == std::string::npos || line[first] == '#')
            continue;
        int status = 0;
        try
        {
            std::vector<std::string> words = split_words(line);
            if (words[0] == "sleep")
                session_sleep(words);
            else
            {
                for (const std::string& w : words)
                    for (const char* o : session_wide)
                        if (w == o || w.compare(0, strlen(o) + 1, std::string(o) + "=") == 0)
                            bad(std::string(o) + " holds for the whole session; give it "
                                "before the verb session");
                Args a = read_args(words);
                check_verb(a, true);
                status = execute(host, a);
            }
        }
        catch (const Bad_Input& e)
        {
            std::cerr << "cimhost: " << e.message << "\n";
            status = 2;
        }
        std::cout << std::flush;
        std::cerr << std::flush;
        worst = std::max(worst, status);
    }
    return worst;
}

int run(int argc, char** argv)
{
    for (int i = 1; i < argc; i++)
        if (strcmp(argv[i], "--help") == 0 || strcmp(argv[i], "-h") == 0)
        {
            std::cout << usage_text;
            return 0;
        }
    Args a = read_args(std::vector<std::string>(argv + 1, argv + argc));
    check_verb(a, false);
    if (a.verb == "session" && !a.positional.empty())
        bad("session takes no arguments: it reads its verbs from standard input");

    Options opts;
    opts.module_path = a.module;
    opts.reg_path = a.reg;
    opts.interop = a.interop;
#ifdef CIMHOST_CLASSES
    opts.classes = &CIMHOST_CLASSES;
#endif
    opts.interop_namespace = a.interop_namespace;
    opts.pegasus_enumerations = a.pegasus_enumerations;
    Host host(opts);
    if (!host.ok())
    {
        std::cerr << "cimhost: " << host.error() << "\n";
        return 1;
    }
    return a.verb == "session" ? session(host) : execute(host, a);
}

} // namespace

int main(int argc, char** argv)
{
    try
    {
        return run(argc, argv);
    }
    catch (const Bad_Input& e)
    {
        std::cerr << "cimhost: " << e.message << "\n";
        return 2;
    }
    catch (const std::exception& e)
    {
        std::cerr << "cimhost: " << e.what() << "\n";
        return 1;
    }
}
