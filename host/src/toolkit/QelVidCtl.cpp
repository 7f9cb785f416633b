#include "QelVidCtl.h"

#include "QelVidStyleSheet.h"

const QelMetaObject& QelVidCtl::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelVidCtl", QelMetaKind::Implementation, &QelVidWidget::MetaObject(), "toolkit");
  return meta;
}
const QelMetaObject* QelVidCtl::GetMetaObject() const { return &MetaObject(); }

QelVidCtl::QelVidCtl(QelVidWidget* parent, QelString name) : QelVidWidget(parent, std::move(name)) {}

QelVidCtl::~QelVidCtl() = default;

QelString QelVidCtl::GetResourceFilename(int level) const {
  if (level <= 0) return QelString("QelVidCtl");
  return QelVidWidget::GetResourceFilename(level - 1);
}

HRESULT QelVidCtl::SetCustomStyle(const QelString& sheet, const QelString& style, const QelString& variant) {
  ClearTemplate();
  if (!variant.IsEmpty()) {
    QelVidStyleSheet::Report("style sheet " + sheet.Str() + ", style " + style.Str() + ": variant \"" + variant.Str() +
                             "\" is not supported (it must be empty)");
    return E_FAIL;
  }
  const QelVidStyleSheet* loaded = QelVidStyleSheet::Load(sheet.Str(), style.Str());
  if (!loaded) return E_FAIL;
  if (QelFailed(loaded->Instantiate(this, style.Str()))) return E_FAIL;
  OnTemplateApplied();
  DispatchModifyProperty("");
  return S_OK;
}

const QelString& QelVidCtl::GetStyleName() const {
  // Kept with the shared template, so a control styled per row copies no style name.
  static const QelString none;
  return index_ ? index_->style : none;
}

QelVidWidget* QelVidCtl::RetrieveSypNamedObject(const QelString& name) const {
  if (!index_) return nullptr;
  for (const TemplateIndex::NamedPart& named : index_->namedParts)
    if (named.name == name.Str()) return parts_[named.part].get();
  return nullptr;
}

void QelVidCtl::DispatchModifyProperty(const char* propertyName) {
  if (!index_) return;
  const bool all = !propertyName || !*propertyName;
  for (const TemplateIndex::Binding& binding : index_->bindings) {
    if (!all && binding.property->name != propertyName) continue;
    QelSYPValue value;
    if (QelSYPMetaClass::Read(this, *binding.property, value)) parts_[binding.part]->SetAttribute(binding.attribute, value);
  }
}

void QelVidCtl::SetTemplate(QelVidWidget* root, std::shared_ptr<const TemplateIndex> index,
                            std::vector<QelVar<QelVidWidget>> parts) {
  if (!root || !index || parts.size() != index->partCount) return;
  index_ = std::move(index);
  parts_ = std::move(parts);
  templateRoot_ = QelVar<QelVidWidget>::Retain(root);
  AddChild(root);
}

void QelVidCtl::ClearTemplate() {
  index_ = nullptr;
  parts_.clear();
  if (templateRoot_) RemoveChild(templateRoot_.get());
  templateRoot_ = nullptr;
}
