#include "qm_ui/form/binding.h"

#include "qm_base/msgfunction.h"

using zql::lib::MMSGFunction;

TextFn KeyText(std::string key)
{
    return [key = std::move(key)] { return MMSGFunction::GetValue(key); };
}

TextFn PlainLabel(std::string text)
{
    return [text = std::move(text)] { return text; };
}

std::function<std::vector<std::string>()> KeyTexts(std::vector<std::string> keys)
{
    return [keys = std::move(keys)] {
        std::vector<std::string> texts;
        for (const std::string& key : keys)
            texts.push_back(MMSGFunction::GetValue(key));
        return texts;
    };
}
