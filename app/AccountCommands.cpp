// Accounts.

#include "app/PLWindow.h"

void PLWindow::AddAccount() {}
void PLWindow::UpdateAccount() {}
void PLWindow::RemoveAccount() {}
void PLWindow::AccountSelection() {}
