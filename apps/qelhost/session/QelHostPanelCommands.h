#pragma once
// The review session's commands on the data filtering panel and on what drives it: the
// panel's rows, buttons and scroll, the editor's windows, the workbench, the settings,
// the selection and the sets' light-load mode. Each is an entry of QelHostCommandTable.
#include <string>
#include <vector>

class QelHostSession;

namespace QelHostPanelCommands {
using Args = std::vector<std::string>;
bool Facets(QelHostSession&, const Args&, std::string&);
bool Tick(QelHostSession&, const Args&, std::string&);
bool Untick(QelHostSession&, const Args&, std::string&);
bool Range(QelHostSession&, const Args&, std::string&);
bool Expand(QelHostSession&, const Args&, std::string&);
bool Collapse(QelHostSession&, const Args&, std::string&);
bool Scroll(QelHostSession&, const Args&, std::string&);
bool Refresh(QelHostSession&, const Args&, std::string&);
bool Close(QelHostSession&, const Args&, std::string&);
bool Minimize(QelHostSession&, const Args&, std::string&);
bool Restore(QelHostSession&, const Args&, std::string&);
bool Panel(QelHostSession&, const Args&, std::string&);
bool Window(QelHostSession&, const Args&, std::string&);
bool Workbench(QelHostSession&, const Args&, std::string&);
bool Setting(QelHostSession&, const Args&, std::string&);
bool CloseEditor(QelHostSession&, const Args&, std::string&);
bool Select(QelHostSession&, const Args&, std::string&);
bool LightLoad(QelHostSession&, const Args&, std::string&);
bool UiActive(QelHostSession&, const Args&, std::string&);
bool Why(QelHostSession&, const Args&, std::string&);
bool Reset(QelHostSession&, const Args&, std::string&);
}  // namespace QelHostPanelCommands
