#pragma once
// The entry procedure of one filing request.

#include <QString>
#include <functional>

namespace zv {

// What Main hands a request to once it has passed every check: selecting the back-ends
// and filing the document. The values may be changed by the handler.
using RequestHandler = std::function<void(int& mode, QString& path, QString& name)>;

// Loads the settings, checks the installation and the request in argumentText and hands
// it to handle. A refusal is shown with the critical icon. Returns the exit status:
// 0 when the request was handled, 1 when it was refused.
int Main(const QString& argumentText, const RequestHandler& handle);

}  // namespace zv
