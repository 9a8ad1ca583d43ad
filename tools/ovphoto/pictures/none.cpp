
#include "tools/ovphoto/commands/pictureOptions.h"
#include "tools/ovphoto/terminal.h"

// In place of the pictures, in builds without Cairo.

namespace OvTool {

namespace {

int refuse() {
    complain("ovphoto: this build has no pictures: it was made without Cairo");
    return exitUsage;
}

}  // namespace

int runPlot(const PlotOptions&, const HostSession&) { return refuse(); }

int runReport(const ReportOptions&, const HostSession&) { return refuse(); }

}  // namespace OvTool
