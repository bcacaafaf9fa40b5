#include "teststand/SourceForm.h"

#include "teststand/StandObject.h"

namespace kg::teststand {

const char* const kGridMembers[4] = {"grid1", "grid2", "grid3", "gridsettings1"};
const char* const kPickerMembers[2] = {"dtpFromDate", "dtpToDate"};

namespace {

class GridObject final : public StandObject {
public:
    enum : DispId { kRows = 1, kFixedRows, kCols, kTextMatrix, kGetValueFromCell };

    GridObject(std::string name, GridData data)
        : StandObject("Grid", std::move(name),
                      {{"Rows", kRows},
                       {"FixedRows", kFixedRows},
                       {"cols", kCols},
                       {"textmatrix", kTextMatrix},
                       {"GetValueFromCell", kGetValueFromCell}}),
          d_(std::move(data))
    {
    }

protected:
    Variant run(DispId id, Args& args) override
    {
        switch (id) {
        case kRows: expectArgs(args, 0, "Rows"); return d_.rows;
        case kFixedRows: expectArgs(args, 0, "FixedRows"); return d_.fixedRows;
        case kCols: expectArgs(args, 0, "cols"); return d_.cols;
        case kTextMatrix: return d_.texts[cellIndex(id, args)];
        case kGetValueFromCell: return d_.values[cellIndex(id, args)];
        }
        throw Error::memberNotFound(where(id));
    }

private:
    size_t cellIndex(DispId id, const Args& args) const
    {
        // Read cell by cell over whole grids: no message is made unless it is needed.
        if (args.size() != 2) expectArgs(args, 2, memberName(id));
        int32_t row = 0, col = 0;
        if (!wholeArg(args[0], row)) row = longArg(args, 0, where(id));
        if (!wholeArg(args[1], col)) col = longArg(args, 1, where(id));
        if (row < 0 || row >= d_.rows || col < 0 || col >= d_.cols)
            throw Error::subscript(where(id) + "(" + std::to_string(row) + ", " + std::to_string(col) +
                                   "): the grid has " + std::to_string(d_.rows) + " rows and " +
                                   std::to_string(d_.cols) + " columns");
        return static_cast<size_t>(row) * static_cast<size_t>(d_.cols) + static_cast<size_t>(col);
    }

    GridData d_;
};

class PickerObject final : public StandObject {
public:
    enum : DispId { kValue = 1 };

    PickerObject(std::string name, double serial)
        : StandObject("Picker", std::move(name), {{"Value", kValue}}), serial_(serial)
    {
    }

protected:
    Variant run(DispId id, Args& args) override
    {
        expectArgs(args, 0, memberName(id));
        return Variant::date(serial_);
    }

private:
    double serial_;
};

class ListObject final : public StandObject {
public:
    enum : DispId { kListCount = 1, kList };

    ListObject(std::string name, std::vector<std::string> entries)
        : StandObject("List", std::move(name), {{"ListCount", kListCount}, {"List", kList}}),
          entries_(std::move(entries))
    {
    }

protected:
    Variant run(DispId id, Args& args) override
    {
        if (id == kListCount) {
            expectArgs(args, 0, "ListCount");
            return static_cast<int32_t>(entries_.size());
        }
        expectArgs(args, 1, "List");
        int32_t i = longArg(args, 0, where(id));
        if (i < 0 || static_cast<size_t>(i) >= entries_.size())
            throw Error::subscript(where(id) + "(" + std::to_string(i) + "): the list has " +
                                   std::to_string(entries_.size()) + " entries");
        return entries_[static_cast<size_t>(i)];
    }

private:
    std::vector<std::string> entries_;
};

class FormObject final : public StandObject {
public:
    FormObject(std::string name, FormData data)
        : StandObject("Form", std::move(name), memberTable(data)),
          jobsDatabase_(std::move(data.jobsDatabase))
    {
        // Objects in member id order: id n is objects_[n - 1]; the field lists come last.
        for (const char* g : kGridMembers) {
            auto it = data.grids.find(g);
            if (it != data.grids.end()) objects_.push_back(makeRef<GridObject>(g, std::move(it->second)));
        }
        for (const char* p : kPickerMembers) {
            auto it = data.pickers.find(p);
            if (it != data.pickers.end()) objects_.push_back(makeRef<PickerObject>(p, it->second));
        }
        for (auto& [index, entries] : data.fieldLists)
            lists_[index] = makeRef<ListObject>(std::string(kFieldListMember) + "(" + std::to_string(index) + ")",
                                                std::move(entries));
    }

    const std::string& jobsDatabase() const { return jobsDatabase_; }

protected:
    Variant run(DispId id, Args& args) override
    {
        if (id == kFieldListId) {
            expectArgs(args, 1, kFieldListMember);
            int32_t index = longArg(args, 0, where(id));
            auto it = lists_.find(index);
            if (it == lists_.end())
                throw Error::subscript(where(id) + "(" + std::to_string(index) + ") is not in the form");
            return Ref<Object>(it->second);
        }
        expectArgs(args, 0, memberName(id));
        return objects_.at(static_cast<size_t>(id - 1));
    }

private:
    static constexpr DispId kFieldListId = 100;

    // Only what the file holds: a member the file lacks is a missing member (Error 438).
    static std::vector<MemberInfo> memberTable(const FormData& data)
    {
        std::vector<MemberInfo> table;
        DispId next = 1;
        for (const char* g : kGridMembers)
            if (data.grids.count(g)) table.push_back({g, next++});
        for (const char* p : kPickerMembers)
            if (data.pickers.count(p)) table.push_back({p, next++});
        if (data.hasFieldLists) table.push_back({kFieldListMember, kFieldListId});
        return table;
    }

    std::string jobsDatabase_;
    std::vector<Ref<Object>> objects_;
    std::map<int32_t, Ref<Object>> lists_;
};

}  // namespace

Ref<Object> makeForm(FormData data, std::string name) { return makeRef<FormObject>(std::move(name), std::move(data)); }

std::string formJobsDatabase(const Object* form)
{
    auto* f = dynamic_cast<const FormObject*>(form);
    return f ? f->jobsDatabase() : std::string();
}

}  // namespace kg::teststand
