#include "store/hot_folder_settings.h"

wxCriticalSection FolderCfgLock;

void SetImposeSetting(ImposeSettingTable& table, const wxString& key, const wxString& value,
                      const wxString& keyDisplayValue)
{
    ImposeSettingEntry& entry = table[key];
    entry.Value = value;
    entry.KeyDisplayValue = keyDisplayValue;
}
