// System variables: any name, type and value.
#pragma once

#include <map>
#include <string>
#include <vector>

#include "tests/support/recording/RecordingValue.h"

class RecordingVariables
{
public:
    void set(const std::wstring& name, const RecordingValue& value);
    void remove(const std::wstring& name);

    // The names given to `tsedGetVar`, in order.
    std::vector<std::wstring> asked;

    // Null when there is none; any case.
    const RecordingValue* find(const std::wstring& name) const;

private:
    std::map<std::wstring, RecordingValue> mValues; // by folded name
};
