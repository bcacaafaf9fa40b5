#include "apps/demo/ReportRequests.h"

#include "karstgraph/karstgraph.h"

namespace kg::demo {

const std::vector<ReportRequest>& reportRequests()
{
    static const std::vector<ReportRequest> requests = {
        {"GenerateChart_HourlyGraph1", "Hourly 1", KG_DISPID_GENERATECHART_HOURLYGRAPH1, "grid1"},
        {"GenerateChart_HourlyGraph2", "Hourly 2", KG_DISPID_GENERATECHART_HOURLYGRAPH2, "grid2"},
        {"GenerateChart_HourlyGraph3", "Hourly 3", KG_DISPID_GENERATECHART_HOURLYGRAPH3, "grid3"},
        {"GenerateChart_PropGraph1", "Prop 1", KG_DISPID_GENERATECHART_PROPGRAPH1, "grid1"},
        {"GenerateChart_PropGraph2", "Prop 2", KG_DISPID_GENERATECHART_PROPGRAPH2, "grid2"},
        {"GenerateChart_PropGraph3", "Prop 3", KG_DISPID_GENERATECHART_PROPGRAPH3, "grid3"},
        {"GenerateChart_YearlyRpt1", "Yearly 1", KG_DISPID_GENERATECHART_YEARLYRPT1, "grid1"},
        {"GenerateChart_YearlyRpt2", "Yearly 2", KG_DISPID_GENERATECHART_YEARLYRPT2, "grid2"},
        {"GenerateChart_YearlyRpt3", "Yearly 3", KG_DISPID_GENERATECHART_YEARLYRPT3, "grid3"},
        {"GenerateChart_BookingsReport", "Bookings", KG_DISPID_GENERATECHART_BOOKINGSREPORT, nullptr},
        {"GenerateChart_SalesDeclaration", "Sales Declaration", KG_DISPID_GENERATECHART_SALESDECLARATION, nullptr},
        {"GenerateChart_ServCatSumm", "Service Categories", KG_DISPID_GENERATECHART_SERVCATSUMM, nullptr},
        {"GenerateChart_JobStatusReport", "Job Status", KG_DISPID_GENERATECHART_JOBSTATUSREPORT, nullptr},
    };
    return requests;
}

std::string buttonName(const ReportRequest& request)
{
    const std::string name = request.name;
    const std::string prefix = "GenerateChart_";
    return "cmd" + (name.compare(0, prefix.size(), prefix) == 0 ? name.substr(prefix.size()) : name);
}

}  // namespace kg::demo
