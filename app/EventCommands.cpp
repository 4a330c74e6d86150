// Events of the selected company.

#include "app/PLWindow.h"

void PLWindow::ChangeCompanyEventType(short) {}
void PLWindow::AddCompanyEvent() {}
void PLWindow::UpdateCompanyEvent() {}
void PLWindow::RemoveCompanyEvent() {}
void PLWindow::CompanyEventSelection() {}
