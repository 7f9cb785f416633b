#include "QelHostBrowser.h"

#include <algorithm>
#include <cctype>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <ostream>

#include "Qel3DViewer.h"
#include "QelDbrBrowser.h"
#include "QelFrmEditor.h"
#include "QelIAlias.h"
#include "QelHostPanel.h"
#include "QelHostSession.h"
#include "QelIDbrBrowserContext.h"
#include "QelIDbrBrowserViewBaseUI.h"
#include "QelILumCapture.h"
#include "QelIVIABaseUI.h"
#include "QelListValQelUnicodeString.h"
#include "QelModelScene.h"
#include "QelPngWriter.h"
#include "QelReviewFramework.h"

namespace {
constexpr int kLightBrowserType = 1;

// The light views browser opened on the session's model; closed when it goes out of scope.
class OpenBrowser {
 public:
  bool Open(QelHostSession& session, std::string& error) {
    if (!session.Root()) {
      error = "no model is open";
      return false;
    }
    QelReviewFramework::Register();
    auto rootPath = QelMakeVar<QelPathElement>();
    rootPath->AddChildElement(session.Root());
    auto previews = QelMakeVar<Qel3DViewer>(576, 432);
    previews->SetSceneSource(QelMakeVar<QelModelScene>(session.Root()).get());
    browser_ = QelMakeVar<QelDbrBrowser>(kLightBrowserType, rootPath.get(), previews.get());
    const HRESULT opened = browser_->Open(session.Root(), QelFrmEditor::GetCurrentEditor());
    if (opened == S_OK) return true;
    error = opened == S_FALSE ? "the views browser is not available in the current window"
                              : "the model's product offers no views browser (is the plug-in loaded?)";
    browser_ = nullptr;
    return false;
  }
  ~OpenBrowser() {
    if (browser_) browser_->Close();
  }
  QelDbrBrowser* operator->() const { return browser_.get(); }

 private:
  QelVar<QelDbrBrowser> browser_;
};

// An item without the browser's item interface (a capture of a set that is not loaded
// light) still shows its name.
QelUnicodeString Text(QelBaseUnknown* item, const QelString& column) {
  QelUnicodeString text;
  if (QelVar<QelIVIABaseUI> ui{item}) {
    ui->GetPropertyValue(column, text);
  } else if (QelVar<QelIAlias> named{item}; named && column == "NAME") {
    named->GetAlias(text);
  }
  return text;
}

size_t Width(const std::string& utf8) {
  size_t n = 0;
  for (unsigned char c : utf8) n += (c & 0xC0) != 0x80;
  return n;
}

std::string Pad(const std::string& text, size_t width) {
  const size_t w = Width(text);
  return text + std::string(w < width ? width - w : 0, ' ');
}

std::string Html(const std::string& text) {
  std::string out;
  for (char c : text) {
    switch (c) {
      case '&': out += "&amp;"; break;
      case '<': out += "&lt;"; break;
      case '>': out += "&gt;"; break;
      case '"': out += "&quot;"; break;
      default: out += c;
    }
  }
  return out;
}

// A file name made of the item's name: letters, digits, '.', '-' and '_' kept.
std::string FileName(int number, const std::string& name) {
  std::string stem;
  for (unsigned char c : name) stem += (std::isalnum(c) || c == '.' || c == '-' || c == '_') ? char(c) : '_';
  char prefix[16];
  std::snprintf(prefix, sizeof prefix, "%03d-", number);
  return prefix + stem + ".png";
}

bool PrintTable(QelHostSession& session, OpenBrowser& browser) {
  QelListValQelUnicodeString headers;
  std::vector<QelString> columns = browser->GetColumns(headers);
  std::ostream& out = session.Out();
  QelUnicodeString title;
  if (QelVar<QelIDbrBrowserContext> context{browser->GetBrowserContext().get()}) context->GetBrowserTitle(title);
  out << title.Utf8() << ": " << browser->GetNodes().size() << " node(s)\n";
  for (const auto& node : browser->GetNodes()) {
    out << node.name.Str() << '\n';
    std::vector<std::vector<std::string>> rows;
    std::vector<size_t> widths;
    for (int c = 1; c <= headers.Size(); ++c) widths.push_back(Width(headers[c].Utf8()));
    for (const auto& item : node.items) {
      std::vector<std::string> row;
      for (size_t c = 0; c < columns.size(); ++c) {
        row.push_back(Text(item.get(), columns[c]).Utf8());
        if (c < widths.size()) widths[c] = std::max(widths[c], Width(row.back()));
      }
      rows.push_back(std::move(row));
    }
    auto line = [&](const std::vector<std::string>& cells) {
      out << ' ';
      for (size_t c = 0; c < cells.size(); ++c) out << ' ' << (c + 1 < cells.size() ? Pad(cells[c], widths[c]) : cells[c]);
      out << '\n';
    };
    std::vector<std::string> head;
    for (int c = 1; c <= headers.Size(); ++c) head.push_back(headers[c].Utf8());
    line(head);
    if (rows.empty()) out << "  (no items)\n";
    for (const auto& row : rows) line(row);
  }
  return true;
}

bool WriteThumbnails(QelHostSession& session, OpenBrowser& browser, const std::string& folder, std::string& error) {
  std::error_code ec;
  std::filesystem::create_directories(folder, ec);
  if (ec) {
    error = "cannot make the folder '" + folder + "': " + ec.message();
    return false;
  }
  int total = 0;
  for (const auto& node : browser->GetNodes()) total += node.items.Size();
  std::ostream& out = session.Out();
  // The page is titled as the browser is (the catalog's title).
  QelUnicodeString title;
  if (QelVar<QelIDbrBrowserContext> context{browser->GetBrowserContext().get()}) context->GetBrowserTitle(title);
  std::string html =
      "<!DOCTYPE html>\n<html><head><meta charset=\"utf-8\"><title>" + Html(title.Utf8()) + "</title>\n"
      "<style>body{font-family:sans-serif;margin:1em}section{margin-bottom:1.5em}"
      "figure{display:inline-block;margin:.5em;text-align:center;vertical-align:top}"
      "img{width:288px;height:216px;border:1px solid #888}figcaption{max-width:288px}"
      ".description{color:#555}</style></head><body>\n<h1>" + Html(title.Utf8()) + "</h1>\n";
  int number = 0, failed = 0, skipped = 0;
  for (const auto& node : browser->GetNodes()) {
    html += "<section>\n<h2>" + Html(node.name.Str()) + "</h2>\n";
    if (node.items.Size() == 0) html += "<p>(no items)</p>\n";
    for (const auto& item : node.items) {
      ++number;
      const std::string name = Text(item.get(), "NAME").Utf8();
      QelVar<QelIDbrBrowserViewBaseUI> ui{item.get()};
      const std::string description = ui ? ui->GetDescription().Utf8() : std::string();
      const std::string file = FileName(number, name);
      out << "[" << number << "/" << total << "] " << name << std::flush;
      QelVar<QelIVIABaseUI> via{item.get()};
      if (!via) {
        ++skipped;
        out << ": not a light view or capture, no preview\n";
        html += "<figure><figcaption><b>" + Html(name) + "</b><br><span class=\"description\">(not loaded light: no preview)</span></figcaption></figure>\n";
        continue;
      }
      QelPixelImage* raw = nullptr;
      via->GetThumbnail(&raw);
      auto image = QelVar<QelPixelImage>::Adopt(raw);
      std::string why;
      if (!image) why = "no thumbnail";
      else if (!QelPngWriter::Write(*image, (std::filesystem::path(folder) / file).string(), why)) why = why.empty() ? "not written" : why;
      if (!why.empty()) {
        ++failed;
        out << ": " << why << '\n';
        html += "<figure><figcaption><b>" + Html(name) + "</b> (no picture)</figcaption></figure>\n";
        continue;
      }
      out << " -> " << file << '\n';
      html += "<figure><img src=\"" + Html(file) + "\" alt=\"" + Html(name) + "\"><figcaption><b>" + Html(name) +
              "</b><br><span class=\"description\">" + Html(description) + "</span></figcaption></figure>\n";
    }
    html += "</section>\n";
  }
  html += "</body></html>\n";
  const std::string index = (std::filesystem::path(folder) / "index.html").string();
  std::ofstream page(index, std::ios::binary | std::ios::trunc);
  page << html;
  page.close();
  if (!page) {
    error = "cannot write '" + index + "'";
    return false;
  }
  out << "wrote " << (number - failed - skipped) << " thumbnail(s) and " << index << '\n';
  if (failed > 0) {
    error = std::to_string(failed) + " thumbnail(s) not written (see above)";
    return false;
  }
  return true;
}
}  // namespace

bool QelHostBrowserCommand(QelHostSession& session, const std::vector<std::string>& args, std::string& error) {
  const bool thumbnails = !args.empty() && args[0] == "thumbnails";
  if (thumbnails ? args.size() != 2 : !args.empty()) {
    error = "expected no argument, or: thumbnails DIR";
    return false;
  }
  OpenBrowser browser;
  if (!browser.Open(session, error)) return false;
  return thumbnails ? WriteThumbnails(session, browser, args[1], error) : PrintTable(session, browser);
}

bool QelHostActivateCommand(QelHostSession& session, const std::vector<std::string>& args, std::string& error) {
  if (args.size() != 1) {
    error = "expected the name of a browser item";
    return false;
  }
  OpenBrowser browser;
  if (!browser.Open(session, error)) return false;
  for (const auto& node : browser->GetNodes())
    for (const auto& item : node.items) {
      if (Text(item.get(), "NAME").Utf8() != args[0]) continue;
      session.BeginChanges();
      browser->Activate(item.get());
      session.EndChanges();
      if (QelVar<QelILumCapture>(item.get())) session.SetActivatedCapture(args[0]);
      // The rows follow the display the capture left, through the panel's own refresh.
      if (QelHostPanel::PressRefresh(session.Editor())) session.Out() << "  panel refreshed\n";
      if (Qel3DViewer* viewer = session.Viewer()) {
        const QelMathPoint& eye = viewer->GetMain3DViewpoint()->GetOrigin();
        session.Out() << "  viewpoint at (" << eye.x << ", " << eye.y << ", " << eye.z << ")\n";
      }
      return true;
    }
  error = "the browser lists no item named \"" + args[0] + "\"";
  return false;
}
