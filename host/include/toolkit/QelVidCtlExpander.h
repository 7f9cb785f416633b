#pragma once
// QelVidCtlExpander: a section that shows its body only while expanded. Its title is
// its "text" attribute, else its name; an optional header widget replaces the title.
// Setting the state from code raises nothing; a person's Expand and Collapse raise the
// events "Expanded" and "Collapsed".
#include "QelVidCtl.h"

class QelVidCtlExpander : public QelVidCtl {
 public:
  QelVidCtlExpander(QelVidWidget* parent, const QelString& name) : QelVidCtl(parent, name) {}
  const char* GetWidgetKind() const override { return "Expander"; }

  void SetExpandedState(bool expanded) { SetAttribute("expanded", expanded ? 1 : 0); }
  bool GetExpandedState() const { return IntAttribute("expanded", 1) != 0; }

  void SetHeader(QelVidWidget* header);
  void SetBody(QelVidWidget* body);
  QelVidWidget* GetHeader() const { return header_; }
  QelVidWidget* GetBody() const { return body_; }

  void Expand();
  void Collapse();

  static QelSYPEvent* ExpandedEvent();
  static QelSYPEvent* CollapsedEvent();
  QelSYPEvent* FindEvent(const std::string& name) const override;

 protected:
  ~QelVidCtlExpander() override = default;

 private:
  QelVidWidget* header_ = nullptr;  // children of the expander
  QelVidWidget* body_ = nullptr;
};
