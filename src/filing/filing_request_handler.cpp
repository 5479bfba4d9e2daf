#include "filing/filing_request_handler.h"

#include "filing/batch_filing.h"
#include "filing/work_with_str.h"
#include "startup/backend_selection.h"

namespace zv {

QString HandleFilingRequest(const CommandLine& cl, int mode, const QString& path,
                            const QString& name) {
    if (cl.batch) {
        return HandleBatchRequest(cl, mode, path, name);
    }
    GetMSSQLParam();
    return WorkWithStr(mode, path, name);
}

}  // namespace zv
