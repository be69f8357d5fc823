// Adapter events as a WBEM client sees them: subscribed to
// VESPERA_AlertIndication in the stand-in CIM server, with the simulated
// library's events, at the module's own delivery pace.

#include "AlertSupport.h"

using namespace alerts_test;

namespace
{

struct Catalogue_Row
{
    int key;
    const char* messageId;
    const char* cause;
    const char* action;
};

const char NONE[] = "No action required.";
const char CONFIG[] = "Check switch and HBA configuration.";

const Catalogue_Row catalogue[] = {
    { 0x20001, "VSPR131073", "Base port logged into Fabric.", NONE },
    { 0x20002, "VSPR131074", "Base port logged out of Fabric.", NONE },
    { 0x20004, "VSPR131076", "User plugged in a SFP.", NONE },
    { 0x20005, "VSPR131077", "SFP removed.", "Check whether SFP is inserted properly." },
    { 0x20006, "VSPR131078", "A POM is a Pluggable Optical Module inserted into a Small "
      "Form-Factor Pluggable (SFP) socket. Event is triggered if there is a change of current "
      "value against threshold of operational characteristics (temperature, voltage and rx/tx "
      "power) of SFP.", "If POM level is not normal please check the SFP." },
    { 0x20007, "VSPR131079", "Base port enabled by user command.", NONE },
    { 0x20008, "VSPR131080", "Base port disabled by user command.", NONE },
    { 0x20009, "VSPR131081", "Authentication successful.", NONE },
    { 0x2000A, "VSPR131082", "Authentication failure.",
      "Mismatch of FC-SP configuration between switch and HBA. Also, check the secret." },
    { 0x2000B, "VSPR131083", "Base port lost connection with fabric.",
      "Check switch and HBA configuration. Also, check SFP and cable connection." },
    { 0x2000C, "VSPR131084", "QOS negotiation failed.", CONFIG },
    { 0x2000D, "VSPR131085", "Fabric WWN changed.", CONFIG },
    { 0x2000E, "VSPR131086", "Can not read SFP registers.", "Recommend to replace the SFP." },
    { 0x2000F, "VSPR131087", "SFP is not supported.", "Recommend to use supported SFP." },
    { 0x80001, "VSPR524289", "Authentication enabled by user command.", NONE },
    { 0x80002, "VSPR524290", "Authentication disabled by user command.", NONE },
    { 0xA0001, "VSPR655361", "Base port ethernet link is up.", NONE },
    { 0xA0002, "VSPR655362", "Base port ethernet link is down.", NONE },
    { 0xA0003, "PLAT260", "Base port ethernet interface is enabled.", NONE },
    { 0xA0004, "PLAT261", "Base port ethernet interface is disabled.", NONE },
};

const Catalogue_Row* row(int category, int id)
{
    for (const Catalogue_Row& r : catalogue)
        if (r.key == int(unsigned(category) << 16 | unsigned(id)))
            return &r;
    return nullptr;
}

// What each category does with each id: delivered, valid but left alone,
// or refused.
enum Fate { DELIVERED, LEFT, REFUSED };

Fate fate(int category, int id)
{
    auto in = [&](int lo, int hi) { return id >= lo && id <= hi; };
    switch (category)
    {
    case 2: return in(1, 15) && id != 3 ? DELIVERED : REFUSED;
    case 3: case 8: return in(1, 2) ? DELIVERED : REFUSED;
    case 10: return in(1, 4) ? DELIVERED : REFUSED;
    case 4: return in(1, 5) ? LEFT : REFUSED;
    case 5: return in(1, 3) ? LEFT : REFUSED;
    case 9: return in(1, 9) ? LEFT : REFUSED;
    case 1: case 6: case 7: case 11: case 12: return REFUSED;
    }
    return DELIVERED;
}

std::string elementClass(int category)
{
    switch (category)
    {
    case 2: case 3: case 8: return "VESPERA_FCPort";
    case 10: return "VESPERA_EthernetPort";
    }
    return "";
}

std::string categoryName(int category)
{
    switch (category)
    {
    case 2: return "Port";
    case 3: return "Lport";
    case 8: return "Audit";
    case 10: return "EthPort";
    }
    return "";
}

class Alerts : public AlertTest
{
};

TEST_F(Alerts, EveryCategoryAndIdMeetsItsFate)
{
    subscribe();
    ch::Object_Path fcPort = devicePath("VESPERA_FCPort", FC_PORT0);
    ch::Object_Path ethPort = devicePath("VESPERA_EthernetPort", ETH_PORT);

    const int categories[] = { -1, 0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 99 };
    Json::Value events(Json::arrayValue);
    std::vector<std::pair<int, int>> delivered;
    size_t refused = 0;
    for (int c : categories)
        for (int id = 0; id <= 16; id++)
        {
            Json::Value e = event(c, id);
            e["eventIdValue"] = "TRU_" + std::to_string(c) + "_" + std::to_string(id);
            events.append(e);
            if (fate(c, id) == DELIVERED)
                delivered.push_back({c, id});
            refused += fate(c, id) == REFUSED;
        }

    LogMark mark;
    std::vector<ch::Instance> got = alertsOf(events);
    ASSERT_EQ(delivered.size(), got.size());

    for (size_t i = 0; i < got.size(); i++)
    {
        int c = delivered[i].first, id = delivered[i].second;
        const ch::Instance& a = got[i];
        SCOPED_TRACE(a.get_text("EventID"));
        ASSERT_EQ("TRU_" + std::to_string(c) + "_" + std::to_string(id), a.get_text("EventID"))
            << "out of order";

        const Catalogue_Row* r = row(c, id);
        EXPECT_EQ(r ? r->messageId : "Unknown", a.get_text("MessageID"));
        EXPECT_EQ(r ? r->cause : "Unknown", a.get_text("Description"));
        EXPECT_EQ(r ? r->cause : "Unknown", a.get_text("ProbableCauseDescription"));
        EXPECT_EQ(std::vector<std::string>{r ? r->action : "Unknown"}, strings(a, "RecommendedActions"));

        std::string cls = elementClass(c);
        if (cls.empty())
        {
            EXPECT_TRUE(isNull(a, "AlertingManagedElement"));
            EXPECT_TRUE(isNull(a, "Category"));
            EXPECT_TRUE(isNull(a, "OtherAlertType"));
            continue;
        }
        EXPECT_TRUE(ch::path_equal(cls == "VESPERA_FCPort" ? fcPort : ethPort,
                                   parsedPath(a.get_text("AlertingManagedElement"))));
        EXPECT_EQ(categoryName(c), a.get_text("Category"));
        bool dmtf = c == 10 && (id == 3 || id == 4);
        EXPECT_EQ(dmtf ? "" : categoryName(c), a.get_text("OtherAlertType"));
    }

    std::string log = mark.text();
    EXPECT_EQ(refused, countLines(log, {"WARN", "Invoked with a unsporrted or invalid event"}));
    EXPECT_EQ(34u, countLines(log, {"WARN", "Non supported event by regular provider is triggered."}));
    EXPECT_EQ(3u, countLines(log, {"WARN", "Unsupported event-port is triggered."}));
    EXPECT_EQ(15u, countLines(log, {"WARN", "unsupported eventr-audit is triggered."}));
}

TEST_F(Alerts, CarryEveryPropertyOfTheEvent)
{
    subscribe();
    std::vector<ch::Instance> systems = served("VESPERA_ComputerSystem");
    ASSERT_EQ(1u, systems.size());

    Json::Value events(Json::arrayValue);
    Json::Value pom = event(2, 6, "pom");
    pom["pomLevel"] = "High Alarm";
    pom["eventSeverity"] = 1;
    pom["eventIdValue"] = "TRU_PORT_POM";
    events.append(pom);
    Json::Value pomWithout = event(2, 6, "pom without level");
    events.append(pomWithout);
    Json::Value fabric = event(2, 13, "fabric");
    fabric["fWwn"] = "10:00:00:05:33:aa:bb:cc";
    events.append(fabric);
    events.append(event(2, 13, "fabric without wwn"));
    Json::Value cee = event(10, 1, "cee");
    cee["cee_state"] = "CEE Linkup";
    events.append(cee);
    events.append(event(10, 1, "cee without state"));
    events.append(event(10, 2, "eth down"));
    events.append(event(10, 3, "eth enabled"));
    Json::Value lport = event(3, 1, "lport");
    lport["eventSeverity"] = 1;
    lport["portIndexString"] = "ignored";
    lport["basePortWWN"] = "10:00:00:05:1e:8a:10:02";
    events.append(lport);
    events.append(event(8, 2, "audit"));
    Json::Value bare(Json::objectValue);
    bare["eventCategory"] = 2;
    bare["eventId"] = 1;
    events.append(bare);
    Json::Value notTru = event(2, 2, "not TRU_");
    notTru["eventIdValue"] = "PORT_OFFLINE";
    events.append(notTru);
    for (int severity : {2, 3, 9})
    {
        Json::Value e = event(2, 4, "severity " + std::to_string(severity));
        e["eventSeverity"] = severity;
        events.append(e);
    }

    LogMark mark;
    std::vector<ch::Instance> got = alertsOf(events);
    ASSERT_EQ(events.size(), got.size());

    // What every alert has.
    for (size_t i = 0; i < got.size(); i++)
    {
        const ch::Instance& a = got[i];
        EXPECT_EQ("VESPERA_AlertIndication", a.class_name);
        EXPECT_EQ("2", a.get_text("AlertingElementFormat"));
        EXPECT_EQ("VESPERA_ComputerSystem", a.get_text("SystemCreationClassName"));
        EXPECT_EQ(systems[0].get_text("Name"), a.get_text("SystemName"));
        EXPECT_EQ("vsprprovider", a.get_text("ProviderName"));
        EXPECT_EQ("1", a.get_text("ProbableCause"));
        EXPECT_EQ(CMPI_dateTime, prop(a, "EventTime")->type);
        EXPECT_FALSE(isNull(a, "EventTime"));
        EXPECT_LE(a.get_text("EventTime"), a.get_text("IndicationTime"));
        EXPECT_FALSE(isNull(a, "MessageArguments"));
        EXPECT_EQ(i ? sequence(got[i - 1]) + 1 : sequence(a), sequence(a)) << "numbered in order";
    }
    EXPECT_GE(sequence(got[0]), 1);

    const ch::Instance& p = got[0];
    EXPECT_EQ("pom", p.get_text("Message"));
    EXPECT_EQ("TRU_PORT_POM", p.get_text("IndicationIdentifier"));
    EXPECT_EQ("TRU_PORT_POM", p.get_text("EventID"));
    EXPECT_EQ("6", p.get_text("PerceivedSeverity"));
    EXPECT_EQ("VESPERA", p.get_text("OwningEntity"));
    EXPECT_EQ("1", p.get_text("AlertType"));
    EXPECT_EQ((std::vector<std::string>{"High Alarm", FC_PORT0}), strings(p, "MessageArguments"));
    EXPECT_EQ(std::vector<std::string>{FC_PORT0}, strings(got[1], "MessageArguments"));
    EXPECT_EQ((std::vector<std::string>{FC_PORT0, "10:00:00:05:33:aa:bb:cc"}),
              strings(got[2], "MessageArguments"));
    EXPECT_EQ(std::vector<std::string>{FC_PORT0}, strings(got[3], "MessageArguments"));
    EXPECT_EQ(std::vector<std::string>{"CEE Linkup"}, strings(got[4], "MessageArguments"));
    EXPECT_TRUE(strings(got[5], "MessageArguments").empty());

    // An Ethernet link down is critical whatever the event says.
    EXPECT_EQ("6", got[6].get_text("PerceivedSeverity"));
    EXPECT_EQ(std::vector<std::string>{ETH_PORT}, strings(got[6], "MessageArguments"));

    // The DMTF registry's form of an interface enabled.
    const ch::Instance& dmtf = got[7];
    EXPECT_EQ("The network port eth2 has been enabled", dmtf.get_text("Message"));
    EXPECT_EQ("DMTF", dmtf.get_text("OwningEntity"));
    EXPECT_EQ("2", dmtf.get_text("AlertType"));
    EXPECT_EQ("", dmtf.get_text("OtherAlertType"));
    EXPECT_EQ("2", dmtf.get_text("PerceivedSeverity"));
    std::vector<std::string> args = strings(dmtf, "MessageArguments");
    ASSERT_EQ(2u, args.size());
    EXPECT_EQ("eth2", args[0]);
    EXPECT_TRUE(ch::path_equal(systems[0].path, parsedPath(args[1]))) << args[1];

    // A logical port's events name the base port, and are informational.
    const ch::Instance& l = got[8];
    EXPECT_EQ("2", l.get_text("PerceivedSeverity"));
    EXPECT_TRUE(ch::path_equal(devicePath("VESPERA_FCPort", FC_PORT1),
                               parsedPath(l.get_text("AlertingManagedElement"))));
    EXPECT_TRUE(strings(l, "MessageArguments").empty());

    EXPECT_EQ(std::vector<std::string>{FC_PORT0}, strings(got[9], "MessageArguments"));

    // Only the category and id: empty texts, no severity, but an alert.
    const ch::Instance& b = got[10];
    EXPECT_EQ("0", b.get_text("PerceivedSeverity"));
    EXPECT_FALSE(isNull(b, "EventID"));
    EXPECT_EQ("", b.get_text("EventID"));
    EXPECT_EQ("", b.get_text("Message"));
    EXPECT_EQ(std::vector<std::string>{""}, strings(b, "MessageArguments"));
    EXPECT_NE(std::string::npos, b.get_text("AlertingManagedElement").find("DeviceID=\"\""));

    // An id that isn't the library's own kind of name is left empty.
    EXPECT_FALSE(isNull(got[11], "IndicationIdentifier"));
    EXPECT_EQ("", got[11].get_text("IndicationIdentifier"));
    EXPECT_EQ("", got[11].get_text("EventID"));

    EXPECT_EQ("6", got[12].get_text("PerceivedSeverity"));
    EXPECT_EQ("3", got[13].get_text("PerceivedSeverity"));
    EXPECT_EQ("0", got[14].get_text("PerceivedSeverity"));
    std::string log = mark.text();
    EXPECT_EQ(1u, countLines(log, {"WARN", "Received a un-expected severity value: 9"}));
    EXPECT_EQ(1u, countLines(log, {"WARN", "Received a un-expected severity value: 0"}));
    EXPECT_EQ(2u, countLines(log, {"INFO", "Message ID = VSPR131078"}));
}

TEST_F(Alerts, MalformedEventsAreDroppedWithALogLine)
{
    subscribe();
    std::string longPort(100000, 'f');
    Json::Value events(Json::arrayValue);
    for (const char* text : {
             "not json at all", "[1, 2]", "42", "\"text\"", "", "{\"eventCategory\": 2,",
             "{}", "{\"eventCategory\": 2}", "{\"eventId\": 1}",
             "{\"eventCategory\": \"2\", \"eventId\": 1}",
             "{\"eventCategory\": 2, \"eventId\": 1.5}",
             "{\"eventCategory\": 4294967298, \"eventId\": 1}",
             "{\"eventCategory\": 2, \"eventId\": 1, \"eventMsg\": 7}",
             "{\"eventCategory\": 2, \"eventId\": 1, \"portIndexString\": null}",
             "{\"eventCategory\": 2, \"eventId\": 1, \"eventSeverity\": \"high\"}",
             "{\"eventCategory\": 2, \"eventId\": 6, \"pomLevel\": [1]}",
             "{\"eventCategory\": 10, \"eventId\": 1, \"cee_state\": {}}" })
        events.append(text);
    // Long, but well formed: it goes through.
    Json::Value big = event(2, 1, "long port");
    big["portIndexString"] = longPort;
    events.append(big);

    LogMark mark;
    std::vector<ch::Instance> got = alertsOf(events);
    ASSERT_EQ(1u, got.size());
    EXPECT_EQ("long port", got[0].get_text("Message"));
    EXPECT_EQ(std::vector<std::string>{longPort}, strings(got[0], "MessageArguments"));

    std::string log = mark.text();
    EXPECT_EQ(3u, countLines(log, {"WARN", "Unable to parse json string to object. Return error"}));
    EXPECT_EQ(3u, countLines(log, {"WARN", "The event is not a JSON object. Return error"}));
    EXPECT_EQ(2u, countLines(log, {"WARN", "eventCategory is a must in the eventObject"}));
    EXPECT_EQ(1u, countLines(log, {"WARN", "eventId is a must in the eventObject"}));
    EXPECT_EQ(4u, countLines(log, {"WARN", "of the event is not an integer. Return error"}));
    EXPECT_EQ(4u, countLines(log, {"WARN", "of the event is not a string. Return error"}));
    EXPECT_EQ(0u, countLines(log, {"ERR", "An event was dropped"}));
}

TEST_F(Alerts, QueuedAlertsWaitForTheNextEnableAndNumberingGoesOn)
{
    int id = subscribe();
    Json::Value events(Json::arrayValue);
    for (int i = 0; i < 30; i++)
        events.append(event(2, 1, std::to_string(i)));
    ASSERT_EQ(30, dtruj_sim_inject_list(compact(events).c_str()));
    ASSERT_TRUE(waitAlerts(3, 5000));
    ASSERT_TRUE(unsubscribe(id).ok());

    size_t before = alerts().size();
    ASSERT_LT(before, 30u);
    usleep(200000);
    EXPECT_EQ(before, alerts().size()) << "delivered while off";
    EXPECT_EQ(-1, dtruj_sim_inject_event(compact(event(2, 1, "while off")).c_str()));

    subscribe();
    alertsOf(listOf({event(2, 2, "after")}));
    std::vector<ch::Instance> all = alerts();
    ASSERT_EQ(32u, all.size());   // the 30, "after" and the sentinel
    for (size_t i = 0; i < 30; i++)
        EXPECT_EQ(std::to_string(i), all[i].get_text("Message"));
    EXPECT_EQ("after", all[30].get_text("Message"));
    for (size_t i = 1; i < all.size(); i++)
        EXPECT_EQ(sequence(all[i - 1]) + 1, sequence(all[i])) << i;
}

TEST_F(Alerts, GoOutInOrderAtTheDeliveryPace)
{
    subscribe();
    ASSERT_EQ(10, dtruj_sim_inject_copies(compact(event(8, 1, "paced")).c_str(), 10));
    ASSERT_TRUE(waitAlerts(1, 5000));
    auto first = std::chrono::steady_clock::now();
    ASSERT_TRUE(waitAlerts(10, 5000));
    auto last = std::chrono::steady_clock::now();
    // Nine pauses of 20 ms at least between the first and the tenth.
    EXPECT_GE(std::chrono::duration_cast<std::chrono::milliseconds>(last - first).count(), 175);
    std::vector<ch::Instance> got = alerts();
    for (size_t i = 1; i < got.size(); i++)
        EXPECT_EQ(sequence(got[i - 1]) + 1, sequence(got[i]));
}

TEST_F(Alerts, ARefusedSubscriptionChangesNothing)
{
    for (const char* fault : {"error", "hba", "std", "unknown", "null"})
    {
        SCOPED_TRACE(fault);
        ASSERT_EQ(0, dtruj_sim_set_fault("register_for_events", fault));
        LogMark mark;
        int id = 0;
        ch::Result r = host->subscribe("root/vespera", "VESPERA_AlertIndication", id);
        EXPECT_EQ(CMPI_RC_ERR_FAILED, r.rc);
        EXPECT_EQ(1u, countLines(mark.text(), {"ERR", "Subscribtion for event notifications FAILED."}));
        EXPECT_EQ(-1, dtruj_sim_inject_event("{}"));
        dtruj_sim_set_fault("register_for_events", nullptr);
        // The server disables what it enabled; the provider has nothing to stop.
        ASSERT_TRUE(host->unsubscribe(id).ok());
        EXPECT_EQ(1u, countLines(mark.text(),
            {"INFO", "No subscription for event notifications happened or successful"}));
    }

    // The callback that can't be set takes the registration back with it.
    ASSERT_EQ(0, dtruj_sim_set_fault("registerEventProcessingCb", "std"));
    int id = 0;
    EXPECT_EQ(CMPI_RC_ERR_FAILED, host->subscribe("root/vespera", "VESPERA_AlertIndication", id).rc);
    EXPECT_EQ(-1, dtruj_sim_inject_event("{}"));
    dtruj_sim_set_fault("registerEventProcessingCb", nullptr);
    host->unsubscribe(id);

    subscribe();
    EXPECT_EQ(1u, alertsOf(listOf({event(2, 1)})).size());
}

TEST_F(Alerts, TheHostsOwnChangesRaiseTheirAlerts)
{
    subscribe();
    host->clear_indications();
    Json::Value off(Json::objectValue);
    off["indexStr"] = FC_PORT0_COLON;
    off["port"]["portStatus"] = false;
    off["propArray"].append("portStatus");
    ASSERT_FALSE(library("setPortByWwn", off).isMember("error"));
    Json::Value ethOff(Json::objectValue);
    ethOff["mac"] = ETH_PORT_COLON;
    ethOff["ethPort"]["portStatus"] = false;
    ethOff["propArray"].append("portStatus");
    ASSERT_FALSE(library("setEthPort", ethOff).isMember("error"));

    std::vector<ch::Instance> got = alertsOf(Json::Value(Json::arrayValue));
    ASSERT_EQ(2u, got.size());
    EXPECT_EQ("VSPR131080", got[0].get_text("MessageID"));
    EXPECT_EQ("Base port disabled by user command.", got[0].get_text("Description"));
    EXPECT_EQ("TRU_PORT_DISABLE", got[0].get_text("EventID"));
    EXPECT_TRUE(ch::path_equal(devicePath("VESPERA_FCPort", FC_PORT0),
                               parsedPath(got[0].get_text("AlertingManagedElement"))));
    EXPECT_EQ("PLAT261", got[1].get_text("MessageID"));
    EXPECT_EQ("The network port eth2 has been disabled", got[1].get_text("Message"));
    EXPECT_EQ("3", got[1].get_text("PerceivedSeverity"));
    EXPECT_TRUE(ch::path_equal(devicePath("VESPERA_EthernetPort", ETH_PORT),
                               parsedPath(got[1].get_text("AlertingManagedElement"))));
}

// What a user watching alerts sees, with events fed through DTRUJ_EVENTS
// (here a regular file; a FIFO works the same).
TEST(AlertsCommand, ListenShowsEachAlertAndStopsAtTheCount)
{
    std::string dir = workDir();
    std::string events = dir + "/events.txt";
    Json::Value down = event(2, 11, "link lost");
    down["eventSeverity"] = 2;
    writeFile(events, compact(down) + "\nnot an event\n" + compact(event(8, 1, "audit")) + "\n");

    auto run = [&](const std::string& options) {
        std::string out = dir + "/listen.out";
        std::string cmd = "HOME=" + dir + " DTRUJ_EVENTS=" + events + " " CIMHOST_EXE " " +
                          options + " listen root/vespera:VESPERA_AlertIndication --seconds 20"
                          " --count 2 >" + out + " 2>&1";
        EXPECT_EQ(0, system(cmd.c_str())) << readFile(out);
        return readFile(out);
    };

    std::string text = run("");
    EXPECT_NE(std::string::npos, text.find("// alert 1: Critical, VSPR131083: link lost\n")) << text;
    EXPECT_NE(std::string::npos, text.find("// at //")) << text;
    EXPECT_NE(std::string::npos, text.find("// alert 2: Information, VSPR524289: audit\n")) << text;
    EXPECT_NE(std::string::npos, text.find("    Category = \"Audit\";")) << text;

    // A new process reads the file from its start again.
    Json::Value doc = parseJson(run("--json"));
    ASSERT_EQ(2u, doc["indications"].size());
    EXPECT_EQ("CMPI_RC_OK", doc["rc_name"].asString());
    EXPECT_EQ("VESPERA_AlertIndication", doc["indications"][1]["instance"]["class"].asString());
}

} // namespace
