// Events: the library's own thread that hands event texts to the
// registered callback, the sources that feed it (the DTRUJ_EVENTS file or
// FIFO, the inject controls, the host's own state changes), and the events
// that those state changes raise.
#include "Sim.h"

#include <chrono>
#include <cstring>
#include <fcntl.h>
#include <poll.h>
#include <sys/stat.h>
#include <unistd.h>

namespace OLMA {
namespace Sim {

void queueEvent(State& s, const std::string& json)
{
    std::lock_guard<std::mutex> g(s.evMtx);
    if (!s.evRegistered)
        return;
    s.evQueue.push_back(json);
    s.evCv.notify_one();
}

void portEvent(State& s, int category, int id, const std::string& portAddr,
               const char* idValue, int severity, const char* msg)
{
    Json::Value e(Json::objectValue);
    e["eventCategory"] = category;
    e["eventId"] = id;
    e["portIndexString"] = plainAddr(portAddr);
    e["basePortWWN"] = portAddr;
    e["eventIdValue"] = idValue;
    e["eventSeverity"] = severity;
    e["eventMsg"] = msg;
    e["timeStamp"] = Json::UInt64(now());
    Json::FastWriter w;
    std::string text = w.write(e);
    if (!text.empty() && text.back() == '\n')
        text.pop_back();
    queueEvent(s, text);
}

// ---------------------------------------------------------------- state changes

// Severities as the adapter reports them: 1 critical, 2 major, 3 minor,
// 4 informational.
enum { SEV_MAJOR = 2, SEV_MINOR = 3, SEV_INFO = 4 };

static void fcStatusEvent(State& s, const Json::Value& port, bool on)
{
    portEvent(s, 2, on ? 7 : 8, port["wwn"].asString(), on ? "TRU_PORT_ENABLE" : "TRU_PORT_DISABLE",
              on ? SEV_INFO : SEV_MINOR, on ? "Base port enabled" : "Base port disabled");
}

static void ethStatusEvent(State& s, const Json::Value& port, bool on)
{
    portEvent(s, 10, on ? 3 : 4, port["mac"].asString(), on ? "TRU_ETH_ENABLE" : "TRU_ETH_DISABLE",
              on ? SEV_INFO : SEV_MINOR, on ? "Ethernet port enabled" : "Ethernet port disabled");
}

void adapterStateEvents(State& s, const Json::Value& adapter, bool on)
{
    // A port that its own setting keeps disabled doesn't change with its
    // adapter.
    for (const Json::Value& p : adapter["fcPorts"])
        if (p.get("portStatus", true).asBool())
            fcStatusEvent(s, p, on);
    for (const Json::Value& p : adapter["ethPorts"])
        if (p.get("portStatus", true).asBool())
            ethStatusEvent(s, p, on);
}

void portChangeEvents(State& s, const Json::Value& port, bool fc,
                      const std::vector<std::string>& changed)
{
    for (const std::string& name : changed) {
        bool on = port[name].asBool();
        if (name == "portStatus") {
            if (fc)
                fcStatusEvent(s, port, on);
            else
                ethStatusEvent(s, port, on);
        } else if (name == "linkUp" && fc) {
            portEvent(s, 2, on ? 1 : 11, port["wwn"].asString(),
                      on ? "TRU_PORT_ONLINE" : "TRU_PORT_LINKDOWN", on ? SEV_INFO : SEV_MAJOR,
                      on ? "Base port logged into the fabric" : "Base port lost the fabric");
        } else if (name == "linkUp") {
            portEvent(s, 10, on ? 1 : 2, port["mac"].asString(),
                      on ? "TRU_ETH_LINKUP" : "TRU_ETH_LINKDOWN", on ? SEV_INFO : SEV_MAJOR,
                      on ? "Ethernet link up" : "Ethernet link down");
        }
    }
}

void authEvent(State& s, const Json::Value& port, bool on)
{
    portEvent(s, 8, on ? 1 : 2, port["wwn"].asString(),
              on ? "TRU_AUDIT_AUTH_ENABLE" : "TRU_AUDIT_AUTH_DISABLE", SEV_INFO,
              on ? "Authentication enabled" : "Authentication disabled");
}

// ---------------------------------------------------------------- the event thread

// Lines written by a user to the file or FIFO named by DTRUJ_EVENTS. A FIFO
// is also opened for writing by us, so that it never reads as ended while no
// writer is connected.
struct EventSource {
    int fd = -1;
    int keepWriter = -1;
    bool fifo = false;
    std::string partial;

    void open(const char* path, off_t offset)
    {
        struct stat st;
        if (stat(path, &st) != 0)
            return;
        fifo = S_ISFIFO(st.st_mode);
        fd = ::open(path, O_RDONLY | O_NONBLOCK | O_CLOEXEC);
        if (fd < 0)
            return;
        if (fifo)
            keepWriter = ::open(path, O_WRONLY | O_NONBLOCK | O_CLOEXEC);
        else
            lseek(fd, offset, SEEK_SET);
    }
    void close()
    {
        if (fd >= 0)
            ::close(fd);
        if (keepWriter >= 0)
            ::close(keepWriter);
        fd = keepWriter = -1;
    }
    // Reads what is there, returns complete lines.
    void readLines(std::vector<std::string>& lines, off_t& offset)
    {
        if (fd < 0)
            return;
        if (fifo) {
            struct pollfd p = {fd, POLLIN, 0};
            if (poll(&p, 1, 0) <= 0 || !(p.revents & POLLIN))
                return;
        }
        char buf[4096];
        ssize_t n;
        while ((n = ::read(fd, buf, sizeof(buf))) > 0) {
            if (!fifo)
                offset += n;
            partial.append(buf, size_t(n));
        }
        size_t pos;
        while ((pos = partial.find('\n')) != std::string::npos) {
            std::string line = partial.substr(0, pos);
            partial.erase(0, pos + 1);
            if (!line.empty() && line.back() == '\r')
                line.pop_back();
            if (line.find_first_not_of(" \t") != std::string::npos)
                lines.push_back(line);
        }
    }
};

static bool stillRegistered(State* s, unsigned generation)
{
    std::lock_guard<std::mutex> g(s->evMtx);
    return !s->evStop && s->evGeneration == generation;
}

// Events wait in the queue while no callback is registered, as between
// register_for_events and registerEventProcessingCb: they go to the first
// callback that comes, not to nobody.
static void eventThread(State* s, std::string path, unsigned generation)
{
    EventSource src;
    off_t offset;
    {
        std::lock_guard<std::mutex> g(s->evMtx);
        offset = s->evFileOffset;
    }
    if (!path.empty())
        src.open(path.c_str(), offset);
    for (;;) {
        std::vector<std::string> lines;
        src.readLines(lines, offset);
        std::deque<std::string> batch;
        {
            std::unique_lock<std::mutex> g(s->evMtx);
            if (s->evGeneration != generation)
                break;
            s->evFileOffset = offset;
            for (auto& l : lines)
                s->evQueue.push_back(l);
            if ((s->evQueue.empty() || !eventCallback().load()) && !s->evStop)
                s->evCv.wait_for(g, std::chrono::milliseconds(50));
            if (s->evStop || s->evGeneration != generation)
                break;
            if (!eventCallback().load())
                continue;
            batch.swap(s->evQueue);
        }
        // The callback runs without our locks: the module may call back
        // into the library from it. What is left of a burst when the
        // caller unregisters is dropped, as it is from the queue; when it
        // only takes its callback back, the rest waits for the next one.
        size_t done = 0;
        for (; done < batch.size(); done++) {
            if (!stillRegistered(s, generation))
                break;
            EventProcessCB cb = eventCallback().load();
            if (!cb) {
                std::lock_guard<std::mutex> g(s->evMtx);
                s->evQueue.insert(s->evQueue.begin(), batch.begin() + long(done), batch.end());
                break;
            }
            cb(batch[done].c_str());
            s->evDelivered++;
        }
    }
    src.close();
}

void notifyEvents(State& s)
{
    std::lock_guard<std::mutex> g(s.evMtx);
    s.evCv.notify_all();
}

bool startEvents(State& s, bool dropOld)
{
    std::lock_guard<std::mutex> g(s.evMtx);
    if (dropOld)
        s.evQueue.clear();
    if (s.evRegistered)
        return true;
    s.evRegistered = true;
    s.evStop = false;
    ++s.evGeneration;
    const char* path = getenv("DTRUJ_EVENTS");
    s.evThread = std::thread(eventThread, &s, std::string(path ? path : ""), s.evGeneration);
    return true;
}

void stopEvents(State& s)
{
    std::thread t;
    {
        std::lock_guard<std::mutex> g(s.evMtx);
        if (!s.evRegistered)
            return;
        s.evRegistered = false;
        s.evStop = true;
        s.evQueue.clear();
        s.evCv.notify_all();
        t.swap(s.evThread);
    }
    if (!t.joinable())
        return;
    // Called from the event callback itself: the thread can't join itself,
    // so it is let go and ends at its next look at the stop flag.
    if (t.get_id() == std::this_thread::get_id())
        t.detach();
    else
        t.join();
}

} // namespace Sim
} // namespace OLMA

using namespace OLMA::Sim;

// ---------------------------------------------------------------- controls

// Queues event texts for the event thread, all at once, so that they reach
// the callback back to back; the number queued, or -1 if nobody registered.
static int injectAll(const std::vector<std::string>& texts)
{
    State& s = state();
    std::lock_guard<std::mutex> g(s.evMtx);
    if (!s.evRegistered)
        return -1;
    for (const std::string& t : texts)
        s.evQueue.push_back(t);
    s.evCv.notify_one();
    return int(texts.size());
}

// Delivers one event text on the event thread; -1 if nobody registered.
DTRUJ_API int dtruj_sim_inject_event(const char* json)
{
    if (!json)
        return -1;
    return injectAll({json}) < 0 ? -1 : 0;
}

// A burst of count copies of one event text.
DTRUJ_API int dtruj_sim_inject_copies(const char* json, int count)
{
    if (!json || count < 0)
        return -1;
    return injectAll(std::vector<std::string>(size_t(count), json));
}

// A burst of the elements of a JSON array, in order: a string element is
// the event text itself (whatever it holds, so that malformed events can
// be part of a burst), any other element is written as compact JSON. -1 for
// a text that isn't a JSON array.
DTRUJ_API int dtruj_sim_inject_list(const char* jsonArray)
{
    Json::Value list;
    Json::Reader reader;
    if (!jsonArray || !reader.parse(jsonArray, list, false) || !list.isArray())
        return -1;
    Json::FastWriter writer;
    std::vector<std::string> texts;
    for (const Json::Value& e : list) {
        std::string text = e.isString() ? e.asString() : writer.write(e);
        if (!e.isString() && !text.empty() && text.back() == '\n')
            text.pop_back();
        texts.push_back(text);
    }
    return injectAll(texts);
}

// How many event texts went to a callback in this process.
DTRUJ_API unsigned long dtruj_sim_events_delivered(void)
{
    return state().evDelivered.load();
}

// The callback registered now, or null: lets a test play a library that
// still calls it after the caller unregistered.
DTRUJ_API OLMA::EventProcessCB dtruj_sim_event_callback(void)
{
    return eventCallback().load();
}
