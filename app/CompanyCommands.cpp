// Companies.

#include "app/PLWindow.h"

void PLWindow::AddCompany() {}
void PLWindow::AddCompany(Company*, bool) {}
void PLWindow::UpdateCompany() {}
void PLWindow::RemoveCompany(Company*, bool) {}
void PLWindow::CompanySelection() {}
