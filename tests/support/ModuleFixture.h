#pragma once
// The built module opened by name, exactly as a host opens it.
#include <dlfcn.h>

#include <gtest/gtest.h>
#include <hotfolder/HFPlugin.h>

namespace hf_test
{
// The built module opened as a host opens it; the instance is released and
// the module closed after the test.
class ModuleTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        module = dlopen(HF_MODULE_PATH, RTLD_NOW | RTLD_LOCAL);
        ASSERT_NE(module, nullptr) << dlerror();
        make = Entry<GetPluginInstanceFn>("GetPluginInstance");
        release = Entry<ReleasePluginInstanceFn>("ReleasePluginInstance");
        ASSERT_TRUE(make && release);
    }
    void TearDown() override
    {
        if (plugin)
            release(plugin);
        if (module)
            dlclose(module);
    }
    // A fresh instance in place of the current one.
    void NewPlugin()
    {
        if (plugin)
            release(plugin);
        plugin = make(L"EPS");
        ASSERT_NE(plugin, nullptr);
    }

    // Another entry point of the module, by name; null when it has none.
    template <typename Function> Function Entry(const char* name) const
    {
        return reinterpret_cast<Function>(dlsym(module, name));
    }

    void* module = nullptr;
    HFPlugin* plugin = nullptr;
    GetPluginInstanceFn make = nullptr;
    ReleasePluginInstanceFn release = nullptr;
};
} // namespace hf_test
