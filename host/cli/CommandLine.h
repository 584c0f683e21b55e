#pragma once
#include <map>
#include <string>
#include <vector>

// A small argument parser for the sub-commands: "--name value" options,
// flags, and multi-valued options such as "--set KEY=VALUE KEY=VALUE".
struct OptionSpec
{
    std::string name;        // with the dashes: "--out", "-o"
    bool takesValue = false; // "--out DIR"
    bool multi = false;      // takes every following KEY=VALUE token
    std::string alias;       // another spelling of the same option
};

class ParsedArgs
{
public:
    std::vector<std::string> positionals;

    bool Has(const std::string& name) const { return m_values.count(name) != 0; }
    std::string Get(const std::string& name, const std::string& fallback = "") const;
    const std::vector<std::string>& All(const std::string& name) const;

    void Add(const std::string& name, const std::string& value) { m_values[name].push_back(value); }
    void Mark(const std::string& name) { m_values[name]; }

private:
    std::map<std::string, std::vector<std::string>> m_values;
};

// False with a message naming the offending argument.
bool ParseArgs(const std::vector<std::string>& args, const std::vector<OptionSpec>& specs,
               ParsedArgs& parsed, std::string& error);

// Splits "KEY=VALUE"; false when there is no '=' or the key is empty.
bool SplitAssignment(const std::string& text, std::string& key, std::string& value);
