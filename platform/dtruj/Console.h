// What the simulated library offers the module's console methods and those
// who test them: the echo (entries that answer with the request they
// received instead of acting on it, so that one sees what the module
// sends), requests of any shape where an entry reads nothing, and
// overrides of the global information. Nothing here is exported but the
// controls in Console.cpp.
#ifndef DTRUJ_CONSOLE_H
#define DTRUJ_CONSOLE_H

#include <string>
#include <json/json.h>

namespace OLMA {
namespace Sim {

// True, with the reply {"entry": <name>, "request": <request>}, when the
// entry echoes; the call is then also kept in the journal.
bool echoReply(const char* entry, const Json::Value& request, Json::Value& reply);

// Forgets the echo and the journal and reads DTRUJ_ECHO again.
void resetEcho();

// The entries that read nothing from their request: they answer whatever
// request they get, as the library does for a console's params.
bool takesAnyRequest(const char* entry);

// Sets in `target` each member of the "globalInfo" object of `described`
// (the host description or one of its adapters): it plays a library whose
// global information says what the description wants, also what disagrees
// with its adapters.
void overlayGlobalInfo(Json::Value& target, const Json::Value& described);

// Adds a record {"time", "message"} to a port's "logs", which
// getAdvPortDataByPort shows and clearLogsForPort empties; the oldest go
// beyond 100 records.
void appendPortLog(Json::Value& port, const std::string& message);

} // namespace Sim
} // namespace OLMA

#endif
