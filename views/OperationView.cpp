#include "views/OperationView.h"

#include "platform/CheckBox.h"
#include "portfolio/ShareOperation.h"
#include "views/Look.h"
#include "views/OperationListView.h"

OperationView::OperationView(BRect frame, const char* name, BWindow*) : PageView(frame, name)
{
    prevision_ = addCheckBox(this, {8, 8, 160, 8 + look::kFieldHeight}, "cbxPrevision", "With Previsions", 'OCPr');
    operations_ = new OperationListView("lstOperations");
    operations_->addTo(this, {8, 36, look::kPageWidth - 8, 500}, "Operations");
    operations_->SetSelectionMessage(new BMessage('OSel'));
}

bool OperationView::isPrevision() const
{
    return prevision_->Value() == B_CONTROL_ON;
}

void OperationView::SetAccountsList(Account**, int) {}

void OperationView::ClearAllOperations()
{
    operations_->remember();
    operations_->clear();
}

void OperationView::AddOperationList(Operation** operations, int count)
{
    operations_->addAll({operations, operations + count});
}

void OperationView::RecallSelection()
{
    operations_->recall();
}

void OperationView::ForgetSelection()
{
    operations_->forget();
}

void OperationView::RemoveShareOperation(ShareOperation* operation)
{
    operations_->release(operation);
}

void OperationView::UpdateShareOperation(ShareOperation* operation)
{
    operations_->modify(operation);
}
