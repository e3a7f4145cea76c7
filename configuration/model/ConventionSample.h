// Testing::Convention: a test class with one field of every form the convention offers, for the
// convention's tests and its fuzz target.
#pragma once

#include <map>
#include <set>
#include <utility>
#include <vector>

#include "ClassDefinition.h"
#include "Configuration/AnonParam.h"
#include "Configuration/NoCaseCompare.h"

namespace Configuration {
namespace Testing {

enum class Kind { Image = 0, Report = 2 };

// A record kept inside a list value: no element of its own.
struct Hop {
    ACE_CString definition;
    int type = 4;
    bool enabled = true;
    friend bool operator==(const Hop& a, const Hop& b) {
        return a.definition == b.definition && a.type == b.type && a.enabled == b.enabled;
    }

private:
    friend struct Fields::Access;
    template <class Self, class Io>
    static void fields(Self& self, Io& io) {
        io("Definition", self.definition);
        io("DefinitionType", self.type);
        io("Enabled", self.enabled);
    }
};

inline Kind kindFromName(const ACE_CString& text) {
    return text == "REPORT" ? Kind::Report : Kind::Image;
}
inline ACE_CString kindName(Kind kind) {
    return kind == Kind::Report ? "REPORT" : "IMAGE";
}

class Convention : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(Convention);

public:
    ACE_CString name;  // attribute
    ACE_CString text = "default";
    bool flag = true;
    int number = -7;
    unsigned int count = 9;
    unsigned short port = 104;
    std::int64_t big = 5;
    std::uint64_t size = 6;
    BDate date{2010, 3, 4};
    BTime time{5, 6, 7};
    BDateTime stamp{"2011-01-02T03:04:05.006"};
    Kind kind = Kind::Image;
    Kind named = Kind::Image;
    unsigned int portAsSigned = 8001;
    std::vector<ACE_CString> names;
    std::set<int> levels;
    AnonParam param;
    std::vector<AnonParam> params;
    ACE_CString optionalText = "unchanged";
    bool forward = true;
    bool enabledDefault = true;
    bool enabled = true;
    ACE_CString txList;
    bool hasTxList = false;
    std::vector<AnonParam> kept;
    std::vector<AnonParam> dropped;
    std::map<ACE_CString, AnonParam> byTag;
    std::set<ACE_CString, NoCaseCompare> titles;
    std::vector<ACE_CString> listed;
    std::vector<std::pair<ACE_CString, ACE_CString>> targets;
    std::vector<Hop> hops;
    ACE_CString note;             // read and written, not compared
    std::size_t paramCount = 0;   // derived after reading
    ACE_CString mandatory = "m";  // absent: a logged failure
    bool hookResult = true;

private:
    bool afterRead();
};

template <class Self, class Io>
void Convention::fields(Self& self, Io& io) {
    io("Id", Fields::attribute(self.name));
    io("Text", self.text);
    io("Flag", self.flag);
    io("Number", self.number);
    io("Count", self.count);
    io("Port", self.port);
    io("Big", self.big);
    io("Size", self.size);
    io("Date", self.date);
    io("Time", self.time);
    io("Stamp", self.stamp);
    io("Kind", self.kind);
    io("Named", Fields::text(self.named, kindFromName, kindName));
    io("PortAsSigned", Fields::asSigned(self.portAsSigned));
    io("Name", self.names);
    io("Level", self.levels);
    io("AnonParam", self.param);
    io("Param", self.params);
    io("OptionalText", Fields::optional(self.optionalText));
    io("Forward", Fields::optional(self.forward, true));
    io("EnabledDefault", Fields::optional(self.enabledDefault, true));
    io("Enabled", Fields::optional(self.enabled, self.enabledDefault));
    io("TxList", Fields::optional(self.txList).noting(self.hasTxList));
    io("Kept", Fields::wrapped("Item", self.kept));
    io("Dropped", Fields::wrapped("Item", self.dropped, Fields::DropFailed));
    io("ByTag", Fields::wrapped("AnonParam", self.byTag, Fields::DropFailed, &AnonParam::getTag));
    io("Titles", Fields::listValue(self.titles));
    io("Listed", Fields::listValue(self.listed));
    io("Targets", Fields::pairs(self.targets, "Persistent", "Mirror"));
    io("Hops", Fields::listValue(self.hops));
    io("Note", Fields::uncompared(self.note));
    io("ParamCount", Fields::derived(self.paramCount));
    io("Mandatory", Fields::required(self.mandatory));
}

CONFIGURATION_DEFINE_INLINE(Convention, "Convention", Fields::FailureForm::PartialDefaults)

// Derived data follows the fields; the hook's false makes the read incomplete.
inline bool Convention::afterRead() {
    paramCount = params.size();
    return hookResult;
}

}  // namespace Testing
}  // namespace Configuration
