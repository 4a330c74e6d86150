#include "views/OperationView.h"

#include "platform/CheckBox.h"
#include "views/Look.h"

OperationView::OperationView(BRect frame, const char* name, BWindow*) : PageView(frame, name)
{
    prevision_ = addCheckBox(this, {8, 8, 160, 8 + look::kFieldHeight}, "cbxPrevision", "With Previsions", 'OCPr');
}

bool OperationView::isPrevision() const
{
    return prevision_->Value() == B_CONTROL_ON;
}

void OperationView::SetAccountsList(Account**, int) {}
void OperationView::ClearAllOperations() {}
void OperationView::AddOperationList(Operation**, int) {}
void OperationView::RecallSelection() {}
void OperationView::ForgetSelection() {}
