#include "module/FilterModule.h"

#include <dlfcn.h>

#include <algorithm>
#include <string>

static void* FindEntry(void* handle, const char* name)
{
    return dlsym(handle, name);
}

std::unique_ptr<FilterModule> FilterModule::Open(const wxString& path, wxString& error)
{
    dlerror();
    // RTLD_LOCAL: the module's own copies of shared client code must not
    // interpose on anything else in the process.
    void* handle = dlopen(path.fn_str(), RTLD_NOW | RTLD_LOCAL);
    if (!handle)
    {
        const char* reason = dlerror();
        error = wxString::Format("cannot load the filter module %s: %s", path,
                                 reason ? wxString::FromUTF8(reason) : wxString("unknown reason"));
        return nullptr;
    }
    std::unique_ptr<FilterModule> module(new FilterModule);
    module->m_path = path;
    module->m_handle = handle;

    struct Entry
    {
        const char* name;
        void** slot;
    } entries[] = {
        {"InitializePlugin", reinterpret_cast<void**>(&module->m_initialize)},
        {"UninitializePlugin", reinterpret_cast<void**>(&module->m_uninitialize)},
        {"GetPluginInfo", reinterpret_cast<void**>(&module->m_getInfo)},
        {"GetPluginInstance", reinterpret_cast<void**>(&module->m_getInstance)},
        {"ReleasePluginInstance", reinterpret_cast<void**>(&module->m_release)},
    };
    for (Entry& entry : entries)
    {
        *entry.slot = FindEntry(handle, entry.name);
        if (!*entry.slot)
        {
            error =
                wxString::Format("the filter module %s lacks the entry point %s", path, entry.name);
            // Nothing of the module has run yet, so it can go again.
            module->m_handle = nullptr;
            dlclose(handle);
            return nullptr;
        }
    }
    // Optional: older modules give no reasons for what they refuse.
    module->m_describeRefusal =
        reinterpret_cast<DescribeRefusalFn>(FindEntry(handle, "DescribeRefusal"));
    module->m_initialize();
    return module;
}

FilterModule::~FilterModule()
{
    if (m_handle && m_uninitialize)
        m_uninitialize();
    // The module stays mapped: wxWidgets may still refer to class information
    // and strings it registered, and it is released at process exit anyway.
}

void FilterModule::Describe(PluginInfo& info) const
{
    m_getInfo(&info);
}

PluginPtr FilterModule::NewInstance(const wxString& name) const
{
    PluginReleaser releaser;
    releaser.release = m_release;
    return PluginPtr(m_getInstance(name.wc_str()), releaser);
}

wxString FilterModule::DescribeRefusal(const wxString& path) const
{
    const wxCharBuffer native = path.fn_str();
    if (!m_describeRefusal || !native.data())
        return wxString();
    std::string text(256, '\0');
    size_t length = m_describeRefusal(native.data(), &text[0], text.size());
    if (length >= text.size())
    {
        text.assign(length + 1, '\0');
        length = m_describeRefusal(native.data(), &text[0], text.size());
    }
    text.resize(std::min(length, text.size() - 1));
    return wxString::FromUTF8(text.data(), text.size());
}
