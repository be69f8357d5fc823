// The registration file in the format SFCB reads: sections "[Class]" with
// indented "key: value" lines; '#' starts a comment.

#include <fstream>
#include <sstream>

#include "internal.h"

namespace OLMA
{
namespace cimhost
{

static std::string trim(const std::string& s)
{
    size_t b = s.find_first_not_of(" \t\r\n");
    if (b == std::string::npos)
        return "";
    size_t e = s.find_last_not_of(" \t\r\n");
    return s.substr(b, e - b + 1);
}

static bool finish(const Registration_Entry& e, const std::string& where, std::string& err)
{
    if (e.provider.empty())
        err = where + ": class " + e.class_name + " has no provider";
    else if (e.location.empty())
        err = where + ": class " + e.class_name + " has no location";
    else if (!e.kinds)
        err = where + ": class " + e.class_name + " has no type";
    else
        return true;
    return false;
}

bool read_reg_file(const std::string& path, std::vector<Registration_Entry>& entries,
                   std::string& err)
{
    std::ifstream in(path);
    if (!in)
    {
        err = "can't read registration file " + path;
        return false;
    }
    entries.clear();
    std::string line;
    int lineno = 0;
    bool open = false;
    std::string section_at;
    while (std::getline(in, line))
    {
        lineno++;
        std::string where = path + ":" + std::to_string(lineno);
        size_t hash = line.find('#');
        if (hash != std::string::npos)
            line.resize(hash);
        std::string t = trim(line);
        if (t.empty())
            continue;
        if (t[0] == '[')
        {
            if (t.back() != ']' || t.size() < 3)
            {
                err = where + ": malformed section header";
                return false;
            }
            if (open && !finish(entries.back(), section_at, err))
                return false;
            Registration_Entry e;
            e.class_name = trim(t.substr(1, t.size() - 2));
            entries.push_back(e);
            open = true;
            section_at = where;
            continue;
        }
        if (!open)
        {
            err = where + ": line outside of a [class] section";
            return false;
        }
        size_t colon = t.find(':');
        if (colon == std::string::npos)
        {
            err = where + ": expected 'key: value'";
            return false;
        }
        std::string key = lower(trim(t.substr(0, colon)));
        std::string value = trim(t.substr(colon + 1));
        Registration_Entry& e = entries.back();
        std::istringstream words(value);
        std::string w;
        if (key == "provider")
            e.provider = value;
        else if (key == "location")
            e.location = value;
        else if (key == "type")
        {
            while (words >> w)
            {
                if (name_eq(w, "instance"))
                    e.kinds |= MI_INSTANCE;
                else if (name_eq(w, "association"))
                    e.kinds |= MI_ASSOCIATION;
                else if (name_eq(w, "method"))
                    e.kinds |= MI_METHOD;
                else if (name_eq(w, "indication"))
                    e.kinds |= MI_INDICATION;
                else
                {
                    err = where + ": unknown provider type '" + w + "'";
                    return false;
                }
            }
        }
        else if (key == "namespace")
        {
            while (words >> w)
                e.name_spaces.push_back(w);
        }
        // Other keys (group, unload, ...) belong to SFCB's own housekeeping.
    }
    if (open && !finish(entries.back(), section_at, err))
        return false;
    return true;
}

} // namespace cimhost
} // namespace OLMA
