#pragma once
// qelhost's review browser commands: `browser` prints the light views browser of the open
// model (its nodes and, per node, its items under the catalog's column headers), `browser
// thumbnails DIR` writes every item's thumbnail as PNG with an index.html to open in a web
// browser, and `activate NAME` runs a capture's display command as a double click would.
// Each command opens the browser on the model's root and closes it when done; the items
// keep their thumbnails between commands.
#include <string>
#include <vector>

class QelHostSession;

bool QelHostBrowserCommand(QelHostSession& session, const std::vector<std::string>& args, std::string& error);
bool QelHostActivateCommand(QelHostSession& session, const std::vector<std::string>& args, std::string& error);
