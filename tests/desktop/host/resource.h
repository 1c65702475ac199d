//{{NO_DEPENDENCIES}}
#define IDD_ABOUTBOX                    100
#define IDD_OPTIONS                     101
#define IDR_MAINFRAME                   128
#define IDC_NAME                        1000
#define IDC_CURRENCY                    1001
#define IDC_SHOWN                       1002
#define ID_FORMAT_COLOR                 32771
#define ID_TOOLS_OPTIONS                32772
#define ID_TOOLS_NAMES                  32773
#define ID_TOOLS_RULED                  32774
