// Operations.

#include "app/PLWindow.h"

void PLWindow::ChangeOperationType(const String&) {}
void PLWindow::UpdateOperationTotal() {}
void PLWindow::AddOperation() {}
void PLWindow::UpdateOperation() {}
void PLWindow::RemoveOperation() {}
void PLWindow::SelectOperation() {}
