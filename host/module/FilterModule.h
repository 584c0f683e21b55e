#pragma once
#include <memory>

#include <hotfolder/HFPlugin.h>

// Releases a filter object through the module that made it.
struct PluginReleaser
{
    ReleasePluginInstanceFn release = nullptr;
    void operator()(HFPlugin* plugin) const
    {
        if (plugin && release)
            release(plugin);
    }
};
using PluginPtr = std::unique_ptr<HFPlugin, PluginReleaser>;

// A filter module opened with dlopen and its five entry points found by name
// (and DescribeRefusal where the module has it).
class FilterModule
{
public:
    // Null with a one-line reason when the file does not load or lacks an
    // entry point. InitializePlugin has run on success.
    static std::unique_ptr<FilterModule> Open(const wxString& path, wxString& error);
    ~FilterModule();
    FilterModule(const FilterModule&) = delete;
    FilterModule& operator=(const FilterModule&) = delete;

    const wxString& GetPath() const { return m_path; }
    void Describe(PluginInfo& info) const;
    // A fresh filter object, or null when the module could not make one.
    PluginPtr NewInstance(const wxString& name) const;
    // Why the module's filter does not take the file at path; empty when it
    // would, or when the module cannot say.
    wxString DescribeRefusal(const wxString& path) const;

private:
    FilterModule() = default;

    wxString m_path;
    void* m_handle = nullptr;
    InitializePluginFn m_initialize = nullptr;
    UninitializePluginFn m_uninitialize = nullptr;
    GetPluginInfoFn m_getInfo = nullptr;
    GetPluginInstanceFn m_getInstance = nullptr;
    ReleasePluginInstanceFn m_release = nullptr;
    DescribeRefusalFn m_describeRefusal = nullptr;
};
