#pragma once

/// Tells assistive tools what the window and the views that draw themselves are; to be called before the first of them
/// is shown, as often as one likes.
void nameRoles();
