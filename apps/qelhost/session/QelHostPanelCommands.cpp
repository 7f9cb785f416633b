#include "QelHostPanelCommands.h"

#include <cstdlib>
#include <ostream>

#include "Qel2DLWindow.h"
#include "Qel3DViewer.h"
#include "Qel3DWindow.h"
#include "QelApplicationFrame.h"
#include "QelDftWindow.h"
#include "QelHostDisplayReasons.h"
#include "QelHostPanel.h"
#include "QelHostSession.h"
#include "QelModelPrinter.h"
#include "QelModelScene.h"
#include "QelPLMProductOccurrence.h"
#include "QelSettingRepository.h"
#include "QelVidCtlButton.h"
#include "QelVidCtlCheckButton.h"
#include "QelVidCtlExpander.h"
#include "QelVidCtlImageAndLabelCombo.h"
#include "QelVidCtlLineEditor.h"
#include "QelVidCtlScrollableArea.h"
#include "QelVidWidgetPrinter.h"

namespace QelHostPanelCommands {
namespace {
using Row = QelHostPanelRow;
constexpr const char* kRepository = "QelRovDataFiltering";

bool Expect(const Args& args, size_t least, size_t most, const char* usage, std::string& error) {
  if (args.size() >= least && args.size() <= most) return true;
  error = std::string("expects ") + usage;
  return false;
}

QelDbrFraPanel* NeedPanel(QelHostSession& session, std::string& error) {
  QelDbrFraPanel* panel = QelHostPanel::Find(session.Editor());
  if (!panel) error = "no panel is shown (see the setting of this workbench, or the window)";
  return panel;
}

// The row at `path` of the panel as it is now; `rows` keeps it.
const Row* NeedRow(QelHostSession& session, const std::string& path, std::vector<Row>& rows, std::string& error) {
  QelDbrFraPanel* panel = NeedPanel(session, error);
  if (!panel) return nullptr;
  rows = QelHostPanel::ReadRows(panel);
  const Row* row = QelHostPanel::Resolve(rows, path);
  if (!row) {
    const std::string closest = QelHostPanel::Closest(rows, path);
    error = "no row \"" + path + "\"" + (closest.empty() ? "" : "; closest: \"" + closest + "\"");
  }
  return row;
}

template <class T>
T* Part(QelVidWidget* within, const char* name) {
  return within ? dynamic_cast<T*>(within->FindDescendant(name)) : nullptr;
}

bool ClickRow(QelHostSession& session, const Args& args, bool tick, std::string& error) {
  if (!Expect(args, 1, 1, "one label path, for example \"Annotation Sets/All sets\"", error)) return false;
  std::vector<Row> rows;
  const Row* row = NeedRow(session, args[0], rows, error);
  if (!row) return false;
  if (!row->check) {
    error = "\"" + args[0] + "\" has no check box or radio to click";
    return false;
  }
  std::ostream& out = session.Out();
  out << (tick ? "tick " : "untick ") << args[0] << ": ";
  if ((row->state == 1) == tick) {
    out << (tick ? "already ticked\n" : "not ticked\n");
    return true;
  }
  if (!tick && row->kind == Row::Kind::Radio) {
    out << "not changed (a radio choice is left by choosing another)\n";
    return true;
  }
  session.BeginChanges();
  auto* button = dynamic_cast<QelVidCtlCheckButton*>(row->check.get());
  if (button) button->Click();
  std::vector<Row> after = QelHostPanel::ReadRows(QelHostPanel::Find(session.Editor()));
  const Row* now = QelHostPanel::Resolve(after, args[0]);
  out << (now && (now->state == 1) == tick ? "done\n" : "refused\n");
  session.EndChanges();
  return true;
}

int OperatorIndex(QelVidCtlImageAndLabelCombo* combo, const std::string& op) {
  for (int i = 0; combo && i < combo->GetLineCount(); ++i)
    if (combo->GetLine(i).Utf8() == op) return i;
  return -1;
}

bool IsNumber(const std::string& text) {
  char* end = nullptr;
  std::strtod(text.c_str(), &end);
  return !text.empty() && *end == '\0';
}

bool Fold(QelHostSession& session, const Args& args, bool expand, std::string& error) {
  if (!Expect(args, 1, 1, "one label path of a section or a row with sub-rows", error)) return false;
  std::vector<Row> rows;
  const Row* row = NeedRow(session, args[0], rows, error);
  if (!row) return false;
  auto* expander = dynamic_cast<QelVidCtlExpander*>(row->expander.get());
  if (!expander) {
    error = "\"" + args[0] + "\" does not fold";
    return false;
  }
  expand ? expander->Expand() : expander->Collapse();
  session.Out() << (expand ? "expanded " : "collapsed ") << args[0] << '\n';
  return true;
}

bool PressButton(QelHostSession& session, const Args& args, const char* part, const char* said, std::string& error) {
  if (!Expect(args, 0, 0, "no argument", error)) return false;
  QelDbrFraPanel* panel = NeedPanel(session, error);
  if (!panel) return false;
  auto* button = Part<QelVidCtlButton>(panel->GetApplicativeWidget(), part);
  if (!button || !button->IsEnabled()) {
    error = std::string("the panel's ") + said + " button is not enabled";
    return false;
  }
  // The button's own dispatch may put a new dialog in the panel; the old one goes later.
  QelVar<QelDbrFraPanel> hold = QelVar<QelDbrFraPanel>::Retain(panel);
  button->Click();
  session.Out() << "pressed " << said << '\n';
  return true;
}

bool ShowPanel(QelHostSession& session, const Args& args, bool show, std::string& error) {
  if (!Expect(args, 0, 0, "no argument", error)) return false;
  QelDbrFraPanel* panel = NeedPanel(session, error);
  if (!panel) return false;
  panel->SetVisibleFlag(show ? 1 : 0);
  session.Out() << "panel " << (show ? "restored" : "minimized") << '\n';
  return true;
}

const char* KindOf(QelFrmWindow* window) {
  if (window->IsAKindOf("Qel2DLWindow")) return "2D layout";
  if (window->IsAKindOf("QelDftWindow")) return "drafting";
  return "3D";
}

QelFrmWindow* WindowAt(const std::string& number, std::string& error) {
  QelListValQelBaseUnknown_var windows = QelApplicationFrame::GetFrame()->GetLayout()->GetWindowList();
  const int n = IsNumber(number) ? std::atoi(number.c_str()) : 0;
  if (n < 1 || n > windows.Size()) {
    error = "no window " + number + " (window list shows them)";
    return nullptr;
  }
  return QelSysDynamicCast<QelFrmWindow>(windows[n].get());
}
}  // namespace

bool Facets(QelHostSession& session, const Args& args, std::string& error) {
  if (!Expect(args, 0, 0, "no argument", error)) return false;
  QelDbrFraPanel* panel = NeedPanel(session, error);
  if (!panel) return false;
  QelHostPanel::Print(session.Out(), QelHostPanel::ReadRows(panel));
  return true;
}

bool Tick(QelHostSession& session, const Args& args, std::string& error) { return ClickRow(session, args, true, error); }
bool Untick(QelHostSession& session, const Args& args, std::string& error) {
  return ClickRow(session, args, false, error);
}

bool Range(QelHostSession& session, const Args& args, std::string& error) {
  if (!Expect(args, 3, 5, "a range row's path, an operator (= < <=) and a value, then optionally < or <= and a value",
              error))
    return false;
  if (args.size() == 4) {
    error = "the upper bound needs an operator and a value";
    return false;
  }
  std::vector<Row> rows;
  const Row* row = NeedRow(session, args[0], rows, error);
  if (!row) return false;
  if (row->kind != Row::Kind::Range) {
    error = "\"" + args[0] + "\" is not a range row";
    return false;
  }
  QelVidWidget* widget = row->row.get();
  auto* leftCombo = Part<QelVidCtlImageAndLabelCombo>(widget, "LeftCombo");
  auto* rightCombo = Part<QelVidCtlImageAndLabelCombo>(widget, "RightCombo");
  auto* leftEditor = Part<QelVidCtlLineEditor>(widget, "LeftEditor");
  auto* rightEditor = Part<QelVidCtlLineEditor>(widget, "RightEditor");
  auto* apply = Part<QelVidCtlButton>(widget, "RangeButton");
  const int left = OperatorIndex(leftCombo, args[1]);
  const int right = args.size() == 5 ? OperatorIndex(rightCombo, args[3]) : -1;
  if (left < 0 || (args.size() == 5 && right < 0)) {
    error = "unknown operator \"" + (left < 0 ? args[1] : args[3]) + "\" (the lower bound takes = < <=, the upper < <=)";
    return false;
  }
  for (size_t i = 2; i < args.size(); i += 2)
    if (!IsNumber(args[i])) {
      error = "\"" + args[i] + "\" is not a number";
      return false;
    }
  if (!leftEditor || !rightEditor || !apply) {
    error = "the range row has no editors";
    return false;
  }
  // Refused before anything is typed, so the row keeps showing the range that filters.
  auto* check = dynamic_cast<QelVidCtlCheckButton*>(row->check.get());
  const bool ticking = check && row->state != 1;
  const double upper = args.size() == 5 ? std::strtod(args[4].c_str(), nullptr) : 0.0;
  if (std::string why =
          QelHostPanel::RangeProblem(*row, args[1], std::strtod(args[2].c_str(), nullptr), args.size() == 5, upper,
                                     ticking);
      !why.empty()) {
    const std::string now = QelHostPanel::RangeInEffect(*row);
    error = why + (now == "off" ? "; the row filters nothing, it is not ticked" : "; the row still filters by " + now);
    return false;
  }
  leftCombo->Select(left);
  leftEditor->Enter(QelUnicodeString(args[2].c_str()));
  if (args.size() == 5) {
    rightCombo->Select(right);
    rightEditor->Enter(QelUnicodeString(args[4].c_str()));
  }
  // An unticked range row takes its range with the tick; a ticked one with its button.
  if (!ticking && !apply->IsEnabled()) {
    error = "the range is not valid (the apply button stays disabled)";
    return false;
  }
  session.BeginChanges();
  ticking ? check->Click() : apply->Click();
  session.Out() << "range " << args[0] << " applied\n";
  session.EndChanges();
  return true;
}

bool Expand(QelHostSession& session, const Args& args, std::string& error) { return Fold(session, args, true, error); }
bool Collapse(QelHostSession& session, const Args& args, std::string& error) {
  return Fold(session, args, false, error);
}

bool Scroll(QelHostSession& session, const Args& args, std::string& error) {
  if (!Expect(args, 2, 2, "a horizontal and a vertical offset", error)) return false;
  if (!IsNumber(args[0]) || !IsNumber(args[1])) {
    error = "offsets are numbers";
    return false;
  }
  QelDbrFraPanel* panel = NeedPanel(session, error);
  if (!panel) return false;
  auto* area = Part<QelVidCtlScrollableArea>(panel->GetApplicativeWidget(), "MainScrollableArea");
  if (!area) {
    error = "the panel does not scroll";
    return false;
  }
  area->SetHScrollOffset(std::atoi(args[0].c_str()));
  area->SetVScrollOffset(std::atoi(args[1].c_str()));
  session.Out() << "scrolled to " << area->GetHScrollOffset() << ", " << area->GetVScrollOffset() << '\n';
  return true;
}

bool Refresh(QelHostSession& session, const Args& args, std::string& error) {
  return PressButton(session, args, "RefreshButton", "refresh", error);
}
bool Close(QelHostSession& session, const Args& args, std::string& error) {
  return PressButton(session, args, "CloseButton", "close", error);
}
bool Minimize(QelHostSession& session, const Args& args, std::string& error) {
  return ShowPanel(session, args, false, error);
}
bool Restore(QelHostSession& session, const Args& args, std::string& error) {
  return ShowPanel(session, args, true, error);
}

bool Panel(QelHostSession& session, const Args& args, std::string& error) {
  const bool json = args.size() == 1 && args[0] == "json";
  if (!json && !Expect(args, 0, 0, "no argument, or json", error)) return false;
  QelDbrFraPanel* panel = NeedPanel(session, error);
  if (!panel) return false;
  std::ostream& out = session.Out();
  if (json) {
    out << QelVidPrintJson(panel) << '\n';
    return true;
  }
  out << "[" << panel->GetTitle().Utf8() << "]" << (panel->GetVisibleFlag() ? "" : " (minimized)") << '\n';
  if (!panel->GetVisibleFlag()) return true;
  out << QelVidPrintText(panel->GetApplicativeWidget());
  out << "filters: " << QelHostDisplayReasons::SummaryLine(QelHostDisplayReasons::Summary(panel)) << '\n';
  return true;
}

bool Window(QelHostSession& session, const Args& args, std::string& error) {
  if (!Expect(args, 1, 2, "list, open 3d|2dl|dft, activate N or close N", error)) return false;
  QelFrmLayout* layout = QelApplicationFrame::GetFrame()->GetLayout();
  std::ostream& out = session.Out();
  if (args[0] == "list" && args.size() == 1) {
    QelListValQelBaseUnknown_var windows = layout->GetWindowList();
    for (int i = 1; i <= windows.Size(); ++i) {
      auto* window = QelSysDynamicCast<QelFrmWindow>(windows[i].get());
      if (!window) continue;
      out << "  " << i << " " << KindOf(window) << (window == layout->GetCurrentWindow() ? " (current)" : "")
          << (QelDbrFraPanel::PanelsInViewer(window->GetViewer().get()).empty() ? "" : " with the panel") << '\n';
    }
    return true;
  }
  if (args[0] == "open" && args.size() == 2) {
    if (!session.Editor() || session.Editor()->IsClosed()) {
      error = "no open editor";
      return false;
    }
    QelVar<QelFrmWindow> window;
    if (args[1] == "3d") {
      auto window3d = QelMakeVar<Qel3DWindow>(session.Editor());
      auto viewer = QelMakeVar<Qel3DViewer>(800, 600);
      viewer->SetSceneSource(QelMakeVar<QelModelScene>(session.Root()).get());
      window3d->SetViewer(viewer.get());
      window = QelVar<QelFrmWindow>::Retain(window3d.get());
    } else if (args[1] == "2dl") {
      window = QelVar<QelFrmWindow>::Retain(QelMakeVar<Qel2DLWindow>(session.Editor()).get());
    } else if (args[1] == "dft") {
      window = QelVar<QelFrmWindow>::Retain(QelMakeVar<QelDftWindow>(session.Editor()).get());
    } else {
      error = "window kinds are 3d, 2dl and dft, not \"" + args[1] + "\"";
      return false;
    }
    layout->AddWindow(window.get());
    layout->SetCurrentWindow(window.get());
    out << "window " << layout->GetWindowList().Size() << " (" << KindOf(window.get()) << ") open and active\n";
    return true;
  }
  if ((args[0] == "activate" || args[0] == "close") && args.size() == 2) {
    QelFrmWindow* window = WindowAt(args[1], error);
    if (!window) return false;
    if (args[0] == "activate") {
      layout->SetCurrentWindow(window);
      out << "window " << args[1] << " active\n";
    } else {
      QelVar<QelFrmWindow> hold = QelVar<QelFrmWindow>::Retain(window);
      layout->RemoveWindow(window);
      out << "window " << args[1] << " closed\n";
    }
    return true;
  }
  error = "expects list, open 3d|2dl|dft, activate N or close N";
  return false;
}

bool Workbench(QelHostSession& session, const Args& args, std::string& error) {
  if (!Expect(args, 0, 1, "a workbench name (none: print the current one)", error)) return false;
  QelFrmContext* context = QelFrmContext::GetContext();
  if (!args.empty()) context->SwitchWorkbench(QelString(args[0].c_str()));
  session.Out() << "workbench " << context->GetWorkbenchName().CastToCharPtr() << '\n';
  return true;
}

bool Setting(QelHostSession& session, const Args& args, std::string& error) {
  if (!Expect(args, 1, 2, "a key of QelRovDataFiltering and optionally an int to write", error))
    return false;
  QelSettingRepository* repository = QelSettingRepository::GetRepository(kRepository);
  if (!repository) {
    error = "no settings repository";
    return false;
  }
  const char* key = args[0].c_str();
  if (args.size() == 2) {
    if (!IsNumber(args[1]) || args[1].find_first_of(".eE") != std::string::npos) {
      error = "\"" + args[1] + "\" is not an int";
      return false;
    }
    if (repository->WriteSetting(key, std::atoi(args[1].c_str())) != S_OK || repository->SaveRepository() != S_OK) {
      error = "could not save " + args[0] + " in " + repository->GetFilePath();
      return false;
    }
  }
  int value = 0;
  if (repository->ReadSetting(key, value) == S_OK)
    session.Out() << "setting " << args[0] << " = " << value << '\n';
  else
    session.Out() << "setting " << args[0] << " is not set\n";
  return true;
}

bool CloseEditor(QelHostSession& session, const Args& args, std::string& error) {
  if (!Expect(args, 0, 0, "no argument", error)) return false;
  if (!session.Editor() || session.Editor()->IsClosed()) {
    error = "no open editor";
    return false;
  }
  QelApplicationFrame::GetFrame()->GetLayout()->CloseEditor(session.Editor());
  session.Out() << "editor closed\n";
  return true;
}

bool Select(QelHostSession& session, const Args& args, std::string& error) {
  if (!Expect(args, 0, 1, "an object's name (none: empty the selection)", error)) return false;
  if (!session.Editor() || !session.Root()) {
    error = "no open editor";
    return false;
  }
  QelBaseUnknown* object = nullptr;
  QelListValQelBaseUnknown_var found;
  if (!args.empty()) {
    found = QelModelPrinter::FindByAlias(session.Root(), args[0]);
    if (found.Size() == 0) {
      error = "the model has no object \"" + args[0] + "\"";
      return false;
    }
    object = found[1].get();
  }
  session.Editor()->SetSelection(object);
  session.Out() << (object ? "selected " + args[0] : std::string("selection emptied")) << '\n';
  return true;
}

// The product named `name` of the open model, or null with `error`.
QelPLMProductOccurrence* FindProduct(QelHostSession& session, const std::string& name, std::string& error) {
  QelListValQelBaseUnknown_var found = QelModelPrinter::FindByAlias(session.Root(), name);
  auto* product = found.Size() ? QelSysDynamicCast<QelPLMProductOccurrence>(found[1].get()) : nullptr;
  if (!product) error = "the model has no product \"" + name + "\"";
  return product;
}

bool LightLoad(QelHostSession& session, const Args& args, std::string& error) {
  if (!Expect(args, 2, 2, "a product's name and on or off", error)) return false;
  if (args[1] != "on" && args[1] != "off") {
    error = "expects on or off, not \"" + args[1] + "\"";
    return false;
  }
  if (!session.Root()) {
    error = "no model is open";
    return false;
  }
  QelPLMProductOccurrence* product = FindProduct(session, args[0], error);
  if (!product) return false;
  product->SetLightLoadMode(args[1] == "on");
  session.Out() << "light-load mode of " << args[0] << " " << args[1] << '\n';
  return true;
}

bool UiActive(QelHostSession& session, const Args& args, std::string& error) {
  if (!Expect(args, 1, 1, "the name of a product", error)) return false;
  if (!session.Editor() || !session.Root()) {
    error = "no open editor";
    return false;
  }
  QelPLMProductOccurrence* product = FindProduct(session, args[0], error);
  if (!product) return false;
  session.MakeUIActive(product);
  session.Out() << "UI-active: " << args[0] << '\n';
  return true;
}

bool Why(QelHostSession& session, const Args& args, std::string& error) {
  if (!Expect(args, 1, 1, "the name of an annotation or a set", error)) return false;
  if (!session.Root()) {
    error = "no model is open";
    return false;
  }
  std::vector<std::string> reasons;
  if (!QelHostDisplayReasons::Why(session.Root(), QelHostPanel::Find(session.Editor()), args[0],
                                  session.ActivatedCapture(), reasons, error))
    return false;
  session.Out() << "why " << args[0] << ":\n";
  for (const std::string& reason : reasons) session.Out() << "  " << reason << '\n';
  return true;
}

bool Reset(QelHostSession& session, const Args& args, std::string& error) {
  if (!Expect(args, 0, 0, "no argument", error)) return false;
  if (session.OpeningMarks().empty() || !NeedPanel(session, error)) {
    if (error.empty()) error = "the panel was not shown when the model opened; nothing to go back to";
    return false;
  }
  session.BeginChanges();
  const int clicks = QelHostPanel::RestoreMarks(session.Editor(), session.OpeningMarks());
  session.Out() << "reset: " << clicks << " click(s)\n";
  session.EndChanges();
  session.SetActivatedCapture({});
  return true;
}
}  // namespace QelHostPanelCommands
