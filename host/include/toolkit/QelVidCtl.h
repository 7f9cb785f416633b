#pragma once
// QelVidCtl: a widget that takes its look from a style sheet. SetCustomStyle instantiates
// the style's template (a tree of named parts) under the control, binds introspectable
// properties to part attributes, routes part events to the control's named handlers and
// calls OnTemplateApplied before it returns. A sheet or style that cannot be used is
// reported (file, style and place) and leaves the control without parts.
#include <string>
#include <vector>

#include "QelSYPMetaClass.h"
#include "QelVidWidget.h"

class QelVidCtl : public QelVidWidget {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  QelVidCtl(QelVidWidget* parent, const QelString& name);
  const char* GetWidgetKind() const override { return "Control"; }
  QelString GetResourceFilename(int level) const override;

  // S_OK once the template is in place; E_FAIL after a reported refusal. `variant` is
  // reserved by the toolkit and must be empty.
  HRESULT SetCustomStyle(const QelString& sheet, const QelString& style, const QelString& variant);
  const QelString& GetStyleName() const { return style_; }

  // The part of the applied template with that name, or null.
  QelVidWidget* RetrieveSypNamedObject(const QelString& name) const;

  // Re-reads the bound properties into the parts: all of them for "", else those bound
  // to `propertyName`.
  void DispatchModifyProperty(const char* propertyName) override;

  // Used by the style sheet while it instantiates a template.
  void SetTemplateRoot(QelVidWidget* root);
  void ReserveTemplate(size_t namedParts, size_t bindings);
  void AddNamedPart(const std::string& name, QelVidWidget* part);
  void AddBinding(QelVidWidget* part, const std::string& attribute, const QelSYPMetaClass::Property* property);
  struct Binding {
    QelVar<QelVidWidget> part;
    std::string attribute;
    const QelSYPMetaClass::Property* property;  // owned by the class's table
  };
  const std::vector<Binding>& GetBindings() const { return bindings_; }

 protected:
  ~QelVidCtl() override;
  // Called by SetCustomStyle once the parts exist, bindings and routes included.
  virtual void OnTemplateApplied() {}

 private:
  void ClearTemplate();

  QelString style_;
  std::vector<std::pair<std::string, QelVar<QelVidWidget>>> parts_;
  std::vector<Binding> bindings_;
  QelVar<QelVidWidget> templateRoot_;
};
