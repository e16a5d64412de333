// The service "KeptOutApplications": the applications that the host does not load by itself, because a person
// keeps them out at starts or because they ended it. They stay in every list that they are in, and are loaded
// when somebody asks for them by hand. A host may be without the service.
#pragma once

#include "tsrx.h"

class TESSEL_API TsRxKeptOut : public TsRxObject
{
public:
    static constexpr const wchar_t* kClassName = L"TsRxKeptOut";

    // The object as this service, or null when it is none (null included).
    static TsRxKeptOut* cast(TsRxObject* object)
    {
        return object && object->isKindOf(kClassName) ? static_cast<TsRxKeptOut*>(object) : nullptr;
    }

    // One sentence about why the application at the full path is kept out, and since when; null for one that
    // is not. The text is the host's and stays until the next call.
    virtual const wchar_t* whyKeptOut(const wchar_t* path) = 0;

    // Keeps the application at the full path out at starts, from the next one on, without opening its file,
    // or lets it in again, whatever has kept it out. False, with a line on the command line, when that cannot
    // be stored, when there is no application at the path, or when it was not kept out.
    virtual bool keepOut(const wchar_t* path) = 0;
    virtual bool letIn(const wchar_t* path) = 0;

    bool isKindOf(const wchar_t* className) const override;
};
