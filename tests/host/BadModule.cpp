// A filter module that forgot one of its entry points: it describes itself
// but cannot make a filter object. Hosts must refuse it cleanly.
#include <hotfolder/PluginInfo.h>

extern "C" __attribute__((visibility("default"))) void InitializePlugin() {}
extern "C" __attribute__((visibility("default"))) void UninitializePlugin() {}
extern "C" __attribute__((visibility("default"))) void GetPluginInfo(PluginInfo* info)
{
    info->m_strIdentifier = "Broken.1";
}
extern "C" __attribute__((visibility("default"))) void ReleasePluginInstance(void*) {}
