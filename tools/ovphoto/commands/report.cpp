#include <CLI/CLI.hpp>
#include <memory>

#include "tools/ovphoto/commands/pictureOptions.h"

namespace OvTool {

Action declareReport(CLI::App& app) {
    auto options = std::make_shared<ReportOptions>();
    app.add_option("PATH", options->paths,
                   "A photometric file, - for standard input, or several, or folders to search for them, which "
                   "give an index")
        ->required();
    app.add_option("-o,--out", options->out,
                   "Page to write: .html, or - for standard output; those of an index's files go beside it")
        ->required()
        ->type_name("OUT");
    addAsOption(app, options->as);
    return [options](const HostSession& session) {
        options->as = sourceFormat(session, options->as);
        return runReport(*options, session);
    };
}

}  // namespace OvTool
