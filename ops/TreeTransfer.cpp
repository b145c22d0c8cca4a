// Drops on the tree. Copying, moving and linking come with the copy engine;
// until then a drop is received and changes nothing.

#include "GvTreeView.h"

void GvTreeView::Copy(BMessage*)
{
}

void GvTreeView::Move(BMessage*)
{
}

void GvTreeView::LinkTo(BMessage*)
{
}
