#ifndef KIT_INTERFACE_ALERT_ICONS_H
#define KIT_INTERFACE_ALERT_ICONS_H

#include <Alert.h>

class BView;

namespace BPrivate {

// The 32 x 32 icon of an alert type, its top left at leftTop.
void DrawAlertIcon(BView* view, BPoint leftTop, alert_type type);

}

#endif
