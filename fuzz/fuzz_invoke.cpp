// cTavixGraph through its dispatch surface with whatever a host could send: any dispatch id (the
// fifteen and others), any invoke kind, 0 to 4 arguments of any type (Empty, Null, numbers, dates,
// texts, Nothing, forms, other objects, arrays nested in arrays), the data choice dialogs answered
// with any number, several calls in a row on the same shared state. The headless chart window
// stands in for the windows, a scripted prompter for the dialogs. A call either works or raises
// kg::Error with a known number and a description, and a failed call leaves the mouse pointer as it
// found it before the request (default).
#include <QCoreApplication>
#include <QTemporaryDir>
#include <array>

#include "requests/cTavixGraph.h"
#include "requests/modMain.h"
#include "FuzzSupport.h"
#include "teststand/SampleJobs.h"
#include "teststand/TestStand.h"
#include "ui/Prompter.h"

using namespace kg;
using kg::fuzz::ByteReader;
using kg::fuzz::require;
namespace stand = kg::teststand;

namespace {

// Forms a call may hand over: one fit for every request, then the shapes at the edges.
const char* const kForms[] = {
    R"({"grid1": {"fixedRows": 1, "cells": [["", "Jan", "Feb", "Mar", "Apr", "Total"],
                                             ["Agent A", 12, 7, 3, 1, 23], ["Agent B", 1, 2, 3, 4, 10]]},
        "grid2": {"fixedRows": 1, "cells": [["", "Jan", "Feb", "Total"], ["Agent A", 120.5, 70, 190.5]]},
        "grid3": {"fixedRows": 2, "cells": [["", "Jan", "Feb", "Total"], ["", "a", "b", "c"], ["X", 1, 2, 3]]},
        "gridsettings1": {"fixedRows": 1, "cells": [["Quote type", "Qty", "Value", "Avg Value", "% Jobs", "% Value"],
                                                    ["Retail", 12, 1200.0, 100.0, 40, 35.5],
                                                    ["Trade", 3, 300.0, 100.0, 60, 64.5]]},
        "dtpFromDate": "2026-01-01", "dtpToDate": "2026-12-31",
        "cboFields": {"1": ["Unconfirmed", "Unscheduled", "Cancelled", "Postponed", "Confirmed", "a", "b", "c",
                            "d", "e", "f", "g", "Imported"]}})",
    R"({"grid1": {"cells": []}, "grid2": {"fixedRows": 0, "cells": [[]]}, "grid3": {"cells": [["x"]]},
        "gridsettings1": {"cells": [["a"]]}, "dtpFromDate": "2026-12-31", "dtpToDate": "2026-01-01",
        "cboFields": {"1": []}})",
    R"({"grid1": {"fixedRows": 0, "cells": [[null, "abc", null, "y"], ["1e308", -1e308, "", "x"]]}})",
    R"({"grid1": {"fixedRows": 1, "cells": [["", "a"], [null, null], ["", ""]]},
        "grid2": {"fixedRows": 1, "cells": [["", "a", "b"], ["r", "1,5", "&H10"]]},
        "gridsettings1": {"fixedRows": 1, "cells": [["", "", ""], [null, "abc", null], ["", "", ""]]},
        "dtpFromDate": "0100-01-01", "dtpToDate": "9999-12-31", "cboFields": {"0": ["x"]}})",
    R"({})",
};
constexpr size_t kFormCount = sizeof kForms / sizeof kForms[0];

// Every error a request may end with: the run-time library's and the test stand's.
const std::initializer_list<int32_t> kKnownErrors = {
    errc::InvalidProcedureCall, errc::Overflow,      errc::OutOfMemory,  errc::SubscriptOutOfRange,
    errc::DivisionByZero,       errc::TypeMismatch,  errc::FileNotFound, errc::PathFileAccess,
    errc::ObjectNotSet,         errc::InvalidUseOfNull, errc::WrongArgumentCount, errc::MemberNotFound,
    errc::PrinterError,         errc::HostBase + stand::hosterr::FormFile, errc::HostBase + stand::hosterr::Settings,
    errc::HostBase + stand::hosterr::JobData};

class Session {
public:
    explicit Session(ByteReader& in) : in_(in)
    {
        for (size_t i = 0; i < kFormCount; ++i) forms_[i] = stand::loadFormJson(kForms[i], "fuzz form");
    }

    Variant value(int depth)
    {
        switch (in_.byte() % 16) {
        case 0: return Variant();
        case 1: return Variant::null();
        case 2: return Variant(in_.byte() % 2 == 1);
        case 3: return Variant(in_.raw<int16_t>());
        case 4: return Variant(in_.raw<int32_t>());
        case 5: return Variant(in_.raw<double>());
        case 6: return Variant::date(in_.raw<double>());
        case 7: return Variant(in_.text(40));
        case 8: return Variant(forms_[in_.byte() % kFormCount]);
        case 9: return Variant(Ref<Object>());  // Nothing
        case 10: return array(depth);
        case 11: return Variant(graph_);         // an object that is no form
        case 12: return Variant(int32_t(in_.byte() % 8));  // the small counts requests expect
        case 13: return Variant(std::to_string(in_.byte() % 16) + (in_.byte() % 2 ? ".5" : ""));
        case 14: return formFromText();
        default: {
            // A grid of a form: an object with members, but not the ones a form has.
            try {
                return call(Variant(forms_[0]), "grid1");
            } catch (const Error&) {
                return Variant();
            }
        }
        }
    }

    // One call; false when the bytes are used up.
    bool step()
    {
        if (in_.left() < 3) return false;
        const uint8_t pick = in_.byte();
        DispId id = kOperations[pick % kOperations.size()].id;
        if (pick >= 240) id = pick % 2 ? in_.raw<int32_t>() : id + int32_t(in_.byte() % 5) - 2;

        const uint8_t kindByte = in_.byte();
        static constexpr uint16_t kKinds[] = {kMethod, kPropertyPut, kPropertyGet, kPropertyPutRef,
                                              kMethod | kPropertyGet, 0};
        uint16_t kind = kKinds[kindByte % 6];
        if (kindByte >= 250) kind = in_.raw<uint16_t>();

        Args args;
        for (int n = in_.byte() % 5; n > 0; --n) args.push_back(value(0));
        prompts_->choices.clear();
        bool dialogAnswers = true;  // answers the real dialogs can give: 0..6 or Cancel
        for (int n = in_.byte() % 3; n > 0; --n) {
            prompts_->choices.push_back(choice());
            dialogAnswers = dialogAnswers && ((prompts_->choices.back() >= 0 && prompts_->choices.back() <= 6) ||
                                              prompts_->choices.back() == kChoiceCancelled);
        }

        const int pointerBefore = services().windows->mousePointer();
        bool known = false;
        for (const Operation& op : kOperations) known = known || op.id == id;
        try {
            graph_->invoke(id, kind, args);
            // A request that set the hourglass takes it off again when it ends, except after an
            // answer that no dialog gives.
            if (pointerBefore == kPointerDefault && dialogAnswers)
                require(services().windows->mousePointer() == kPointerDefault, "a call that worked left the hourglass");
        } catch (const Error& e) {
            kg::fuzz::expectError(e, kKnownErrors, "cTavixGraph::invoke");
            // A failed request hands the pointer back; a call no operation took leaves it alone.
            require(services().windows->mousePointer() == (known ? kPointerDefault : pointerBefore),
                    "a failed call left the mouse pointer at " + std::to_string(services().windows->mousePointer()) +
                        " (it was " + std::to_string(pointerBefore) + "): " + e.description());
        } catch (const std::exception& e) {
            kg::fuzz::fail(std::string("cTavixGraph::invoke raised a non-kg exception: ") + e.what());
        }
        return true;
    }

    void setPrompts(ui::ScriptedPrompter* prompts) { prompts_ = prompts; }

private:
    int16_t choice()
    {
        const uint8_t b = in_.byte();
        if (b < 200) return int16_t(b % 7);
        if (b < 230) return kChoiceCancelled;
        return in_.raw<int16_t>();
    }

    Variant array(int depth)
    {
        // Small bounds from any lower bound; an upper bound below the lower is refused as it would be.
        const int32_t lo0 = int8_t(in_.byte()), lo1 = int8_t(in_.byte());
        const int32_t hi0 = lo0 + in_.byte() % 4, hi1 = lo1 + in_.byte() % 4;
        VariantArray a(lo0, hi0, lo1, hi1);
        for (int32_t i = lo0; i <= hi0; ++i)
            for (int32_t j = lo1; j <= hi1; ++j)
                a.at(i, j) = depth < 2 && in_.byte() % 4 == 0 ? value(depth + 1) : Variant(int32_t(i * 10 + j));
        return Variant(std::move(a));
    }

    Variant formFromText()
    {
        const std::string json = in_.text(255);
        try {
            return Variant(stand::loadFormJson(json, "fuzz form"));
        } catch (const Error& e) {
            kg::fuzz::expectError(e, {errc::HostBase + stand::hosterr::FormFile}, "loadFormJson");
            return Variant(json);
        }
    }

    ByteReader& in_;
    std::array<Ref<Object>, kFormCount> forms_;
    Ref<cTavixGraph> graph_ = makeRef<cTavixGraph>();
    ui::ScriptedPrompter* prompts_ = nullptr;
};

void resetSharedState()
{
    modMain::releaseSharedObjects();
    modMain::gvSourceForm = Variant();
    modMain::giChartKind = 0;
    modMain::gvArray = VariantArray();
}

}  // namespace

extern "C" int LLVMFuzzerInitialize(int* argc, char*** argv)
{
    static QCoreApplication app(*argc, *argv);
    static QTemporaryDir scratch;  // the settings file and the jobs database; removed at exit
    const QString folder = scratch.path();
    stand::Config cfg;
    cfg.settingsFile = (folder + "/settings.ini").toStdString();
    cfg.appFolder = folder.toStdString();
    cfg.jobsDatabase = (folder + "/jobs.db").toStdString();
    stand::SampleJobsSpec jobs;
    jobs.count = 40;
    stand::writeSampleJobs(cfg.jobsDatabase, jobs);
    services().hostObjects = stand::makeFactory(cfg);
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    ByteReader in(data, size);
    Services fresh;
    auto prompts = std::make_shared<ui::ScriptedPrompter>();
    fresh.prompter = prompts;
    fresh.hostObjects = services().hostObjects;
    ScopedServices scoped(std::move(fresh));
    resetSharedState();
    {
        Session session(in);
        session.setPrompts(prompts.get());
        for (int calls = 0; calls < 8 && session.step(); ++calls) {
        }
    }
    resetSharedState();
    return 0;
}
