#pragma once

// What the tests of the delimited and columnar imports share: the layout of the format with its defaults,
// changed key by key, and the records imported with the lines of the text window.
#include "FieldBookTestSupport.h"
#include "fieldbook/ParamDriver.h"

#include <gtest/gtest.h>

template <class Config, pyr::FieldBookFormat kFormat>
class LayoutImportTest : public ::testing::Test {
protected:
    void Import(std::string_view text) { Config::ImportText(layout, text, records, &txt); }

    pyr::CParamDriver layout{"", "", kFormat};
    pyr::ui::ScriptedFrontEnd frontEnd;
    pyr::CPyrTxtWnd txt{frontEnd};
    pyr::CCarnet records;
};
