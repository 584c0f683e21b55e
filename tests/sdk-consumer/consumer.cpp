#include <dlfcn.h>

#include <cstdio>

#include <hotfolder/HFPlugin.h>

int main()
{
    void* module = dlopen(MODULE_DIR "/EPS.so", RTLD_NOW);
    if (!module)
    {
        std::fprintf(stderr, "consumer: %s\n", dlerror());
        return 1;
    }
    auto info = reinterpret_cast<GetPluginInfoFn>(dlsym(module, "GetPluginInfo"));
    auto make = reinterpret_cast<GetPluginInstanceFn>(dlsym(module, "GetPluginInstance"));
    auto release =
        reinterpret_cast<ReleasePluginInstanceFn>(dlsym(module, "ReleasePluginInstance"));
    if (!info || !make || !release)
        return 2;
    PluginInfo record;
    info(&record);
    HFPlugin* plugin = make(L"consumer");
    wxString error;
    plugin->GetErrorString(-1005, error);
    std::printf("%s %s %s %s\n", (const char*)record.m_strIdentifier.utf8_str(),
                (const char*)record.m_strVersion.utf8_str(),
                (const char*)record.m_arrExtensions[0].utf8_str(), (const char*)error.utf8_str());
    release(plugin);
    dlclose(module);
    return 0;
}
