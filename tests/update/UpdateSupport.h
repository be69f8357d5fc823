// Shared by the software update tests: InstallFromURI as a client calls it,
// the adapters' paths and firmware versions, and a private TMPDIR in which
// every download directory must come and go.
#ifndef _VSPR_update_UpdateSupport_h
#define _VSPR_update_UpdateSupport_h

#include <sys/stat.h>

#include "ProvidersSupport.h"

// The simulated library's flash entry, and its log of flash attempts.
extern "C" Json::Value adapterUpdateFlash(const Json::Value&);
extern "C" Json::Value getDriverUpdateStatus(const Json::Value&);

namespace update_test
{

using namespace providers_test;

inline size_t flashAttempts()
{
    return getDriverUpdateStatus(Json::Value())["log"].size();
}

class UpdateTest : public ProvidersTest
{
protected:
    void SetUp() override
    {
        ProvidersTest::SetUp();
        tmp = workDir() + "/tmp";
        std::filesystem::remove_all(tmp);
        std::filesystem::create_directory(tmp);
        setenv("TMPDIR", tmp.c_str(), 1);
        // Quick flashes, unless a test wants the time.
        useHost(hostWithFlash(Json::Value()));
    }

    void TearDown() override
    {
        EXPECT_TRUE(std::filesystem::is_empty(tmp)) << "a download directory stayed";
        ProvidersTest::TearDown();
    }

    // The default host, each adapter's "flash" with these members added,
    // and a flash of 20 ms unless they say otherwise.
    static Json::Value hostWithFlash(const Json::Value& flash)
    {
        Json::Value host = defaultHost();
        for (Json::Value& a : host["adapters"])
        {
            a["flash"]["durationMs"] = 20;
            for (const std::string& m : flash.getMemberNames())
                a["flash"][m] = flash[m];
        }
        return host;
    }

    static ch::Object_Path servicePath()
    {
        ch::Result r = ein("VESPERA_HBASoftwareInstallationService");
        EXPECT_EQ(1u, r.paths.size());
        return r.paths.empty() ? classPath("VESPERA_HBASoftwareInstallationService") : r.paths[0];
    }

    static ch::Object_Path adapterPath(size_t n = 0)
    {
        ch::Result r = ein("VESPERA_PortController");
        EXPECT_GT(r.paths.size(), n);
        return r.paths.size() > n ? r.paths[n] : ch::Object_Path();
    }

    static ch::Value uint16s(std::vector<uint64_t> values)
    {
        ch::Value v;
        v.type = CMPI_uint16A;
        v.null = false;
        for (uint64_t x : values)
            v.elements.push_back(ch::Value::of_uint(CMPI_uint16, x));
        return v;
    }

    // The method's return value; the call itself must succeed.
    static uint32_t install(const std::string& uri, const ch::Object_Path* target,
        std::vector<uint64_t> options = {5})
    {
        std::vector<ch::Property> in;
        if (!uri.empty())
            in.push_back({"URI", ch::Value::of_string(uri)});
        if (target)
            in.push_back({"Target", ch::Value::of_ref(*target)});
        in.push_back({"InstallOptions", uint16s(options)});
        ch::Result r = host->cm(servicePath(), "InstallFromURI", in);
        EXPECT_EQ(CMPI_RC_OK, r.rc) << ch::rc_name(r.rc) << " " << r.message;
        EXPECT_EQ(CMPI_uint32, r.return_value.type);
        return r.return_value.num.uint32;
    }

    // The firmware version that the inventory shows for the adapter whose
    // DeviceID is given.
    static std::string firmwareOf(const std::string& deviceId)
    {
        for (const ch::Instance& i : served("VESPERA_AdapterSoftwareIdentity"))
            if (text(i, "InstanceID") == deviceId + "_firmware")
                return text(i, "VersionString");
        return "(none)";
    }

    static std::string deviceIdOf(const ch::Object_Path& adapter)
    {
        const ch::Value* id = adapter.key("DeviceID");
        return id ? id->str : std::string();
    }

    std::string tmp;
};

} // namespace update_test

#endif
