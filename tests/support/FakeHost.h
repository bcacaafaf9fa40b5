#pragma once
// Small host objects for model tests: application services and a settings store in memory that
// record what they were asked, so tests can check both results and call order.
#include <map>
#include <string>
#include <vector>

#include "core/Convert.h"
#include "core/Dispatch.h"
#include "core/Error.h"

namespace kg::test {

class FakeAppServices : public TableObject {
public:
    std::string folder = "/opt/tavix";
    std::string owner = "Tavix";
    std::vector<std::string> calls;   // member names in call order
    std::vector<std::string> events;  // LogFormEvent "event|name"

    Variant invoke(DispId id, uint16_t, Args& args) override
    {
        calls.push_back(members()[size_t(id - 1)].name);
        switch (id) {
        case 1: args.at(0) = Variant(folder); break;
        case 2: args.at(0) = Variant(owner); break;
        case 3: events.push_back(toText(args.at(0)) + "|" + toText(args.at(1))); break;
        default: break;
        }
        return {};
    }
    std::string objectName() const override { return "goAppServices"; }

protected:
    const std::vector<MemberInfo>& members() const override
    {
        static const std::vector<MemberInfo> m = {{"GetAppFolder", 1}, {"GetSettingsOwner", 2}, {"LogFormEvent", 3},
                                                  {"RestoreFormState", 4}, {"SaveFormState", 5}};
        return m;
    }
};

class FakeSettings : public TableObject {
public:
    std::map<std::string, std::string> values;  // "Section\Key" -> text
    std::vector<std::string> reads;             // keys read, in order
    std::vector<std::string> owners;            // owner passed with each read

    Variant invoke(DispId id, uint16_t, Args& args) override
    {
        const std::string key = toText(args.at(0)) + "\\" + toText(args.at(1));
        if (id == 1) {
            reads.push_back(toText(args.at(1)));
            owners.push_back(toText(args.at(3)));
            auto it = values.find(key);
            args.at(4) = Variant(it == values.end() ? toText(args.at(2)) : it->second);
        } else {
            values[key] = toText(args.at(2));
        }
        return {};
    }
    std::string objectName() const override { return "goSettings"; }

protected:
    const std::vector<MemberInfo>& members() const override
    {
        static const std::vector<MemberInfo> m = {{"ReadSetting", 1}, {"WriteSetting", 2}};
        return m;
    }
};

}  // namespace kg::test
