#include "tools/ovphoto/commands/pictureOptions.h"
namespace OvTool {
int runReport(const ReportOptions&, const HostSession&) { return exitUsage; }
}  // namespace OvTool
