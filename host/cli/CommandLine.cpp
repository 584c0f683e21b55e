#include "cli/CommandLine.h"

std::string ParsedArgs::Get(const std::string& name, const std::string& fallback) const
{
    auto it = m_values.find(name);
    if (it == m_values.end() || it->second.empty())
        return fallback;
    return it->second.back();
}

const std::vector<std::string>& ParsedArgs::All(const std::string& name) const
{
    static const std::vector<std::string> none;
    auto it = m_values.find(name);
    return it == m_values.end() ? none : it->second;
}

static const OptionSpec* FindSpec(const std::vector<OptionSpec>& specs, const std::string& arg)
{
    for (const OptionSpec& spec : specs)
        if (spec.name == arg || (!spec.alias.empty() && spec.alias == arg))
            return &spec;
    return nullptr;
}

static bool LooksLikeAssignment(const std::string& text)
{
    return !text.empty() && text[0] != '-' && text.find('=') != std::string::npos;
}

bool ParseArgs(const std::vector<std::string>& args, const std::vector<OptionSpec>& specs,
               ParsedArgs& parsed, std::string& error)
{
    bool onlyPositionals = false;
    for (size_t i = 0; i < args.size(); ++i)
    {
        const std::string& arg = args[i];
        if (onlyPositionals || arg.size() < 2 || arg[0] != '-')
        {
            parsed.positionals.push_back(arg);
            continue;
        }
        if (arg == "--")
        {
            onlyPositionals = true;
            continue;
        }
        std::string name = arg;
        std::string inlineValue;
        bool hasInlineValue = false;
        size_t eq = arg.find('=');
        if (arg.rfind("--", 0) == 0 && eq != std::string::npos)
        {
            name = arg.substr(0, eq);
            inlineValue = arg.substr(eq + 1);
            hasInlineValue = true;
        }
        const OptionSpec* spec = FindSpec(specs, name);
        if (!spec)
        {
            error = "unknown option " + arg;
            return false;
        }
        if (spec->multi)
        {
            parsed.Mark(spec->name);
            if (hasInlineValue)
                parsed.Add(spec->name, inlineValue);
            while (i + 1 < args.size() && LooksLikeAssignment(args[i + 1]))
                parsed.Add(spec->name, args[++i]);
            if (parsed.All(spec->name).empty())
            {
                error = name + " needs at least one KEY=VALUE";
                return false;
            }
        }
        else if (spec->takesValue)
        {
            if (hasInlineValue)
                parsed.Add(spec->name, inlineValue);
            else if (i + 1 < args.size())
                parsed.Add(spec->name, args[++i]);
            else
            {
                error = name + " needs a value";
                return false;
            }
        }
        else
        {
            if (hasInlineValue)
            {
                error = name + " takes no value";
                return false;
            }
            parsed.Mark(spec->name);
        }
    }
    return true;
}

bool SplitAssignment(const std::string& text, std::string& key, std::string& value)
{
    size_t eq = text.find('=');
    if (eq == std::string::npos || eq == 0)
        return false;
    key = text.substr(0, eq);
    value = text.substr(eq + 1);
    return true;
}
