/* Ids of the library's resources, shared by tavrin.rc and the code. Plain
   defines only: the resource compiler reads this file too. */
#ifndef TAVRIN_RESOURCE_IDS_H
#define TAVRIN_RESOURCE_IDS_H

/* Strings that the host reads for itself; no routine of ours loads them. */
#define IDS_HOST_SIGNATURE 1
#define IDS_HOST_OBJECT_NAME 2
#define IDS_HOST_TITLE_FORMAT 4

/* The object's texts for the host's About information. 131, the comment,
   is deliberately absent from the string table: the comment comes back
   empty. */
#define IDS_OBJECT_NAME 128
#define IDS_OBJECT_AUTHOR 129
#define IDS_OBJECT_COPYRIGHT 130
#define IDS_OBJECT_COMMENT 131
#define IDS_OBJECT_WEB 132

/* Four bytes of data for the host; the library never reads them. */
#define IDR_OBJECT_DATA 200

/* The event menus, one top-level popup each. */
#define IDM_ACTIONS 20000
#define IDM_CONDITIONS 20001
#define IDM_EXPRESSIONS 20002

/* The setup dialog and its controls. */
#define IDD_SETUP 20003
#define IDC_NO_ID 65535 /* a control without an id of its own */
#define IDC_START_ANGLE 1001
#define IDC_MASS 1002
#define IDC_LINK_SPACING 1003
#define IDC_GRAVITY 1004
#define IDC_PLATFORM_WIDTH 1005
#define IDC_PLATFORM_HEIGHT 1006
#define IDC_LINK_WIDTH 1007
#define IDC_LINK_HEIGHT 1008
#define IDC_ANCHOR_WIDTH 1009
#define IDC_ANCHOR_HEIGHT 1010
#define IDC_LINK_COUNT 1011
#define IDC_VIEW_TEMPLATE 1012
#define IDC_SETUP_HELP 20004

/* The short help that the setup dialog's "Help" button shows. */
#define IDS_SETUP_HELP_CAPTION 20005
#define IDS_SETUP_HELP_TEXT 20006

/* The object's picture: the icon of the object type, and what the frame
   editor shows while no template is viewed. */
#define IDB_ICON 400
#define IDB_PICTURE 401

/* Events. Each id is both the command id of the event's menu item and the
   string id of its display string; the titles of its parameters, where it
   has any, are the strings id + 1 and id + 2. */
#define ID_CONDITION_IS_SWINGING 26000
#define ID_CONDITION_ON_SWING 26010

#define ID_ACTION_ADD_ANCHOR 25000
#define ID_ACTION_ADD_LINK 25010
#define ID_ACTION_ADD_PLATFORM 25020
#define ID_ACTION_SET_ANCHOR_X 25030
#define ID_ACTION_SET_ANCHOR_Y 25040
#define ID_ACTION_SET_MASS 25050
#define ID_ACTION_SET_ANGLE 25060
#define ID_ACTION_SET_SPEED 25070
#define ID_ACTION_SET_LINK_SPACING 25080
#define ID_ACTION_START_ALL 25090
#define ID_ACTION_START_CHAIN 25100
#define ID_ACTION_STOP_ALL 25110
#define ID_ACTION_STOP_CHAIN 25120
#define ID_ACTION_UPDATE_ALL 25130
#define ID_ACTION_UPDATE_CHAIN 25140
#define ID_ACTION_SET_ACCELERATION 25150

#define ID_EXPRESSION_CHAIN_NUM 27000
#define ID_EXPRESSION_CHAIN_LINKS 27010
#define ID_EXPRESSION_ANCHOR_X 27020
#define ID_EXPRESSION_ANCHOR_Y 27030
#define ID_EXPRESSION_PLATFORM_MASS 27040
#define ID_EXPRESSION_CHAIN_ANGLE 27050
#define ID_EXPRESSION_CHAIN_SPEED 27060
#define ID_EXPRESSION_LINK_SPACING 27070
#define ID_EXPRESSION_PLATFORM_X 27080
#define ID_EXPRESSION_PLATFORM_Y 27090
#define ID_EXPRESSION_CHAIN_INDEX 27100
#define ID_EXPRESSION_DELTA_X 27110
#define ID_EXPRESSION_DELTA_Y 27120
#define ID_EXPRESSION_CHAIN_ACCEL 27130
#define ID_EXPRESSION_LINK_INDEX 27140
#define ID_EXPRESSION_LINK_X 27150
#define ID_EXPRESSION_LINK_Y 27160

#endif
