#pragma once

// What the tests of the delimited and columnar imports share: the layout of the format with its defaults,
// changed key by key, and the records imported with the lines of the text window.
#include "FieldBookTestSupport.h"
#include "fieldbook/ParamDriver.h"

#include <gtest/gtest.h>

template <class Config, pyr::FieldBookFormat kFormat>
class LayoutImportTest : public ::testing::Test {
protected:
    pyr::CCarnet& Import(std::string_view text) {
        Config::ImportText(layout, text, records, &txt);
        return records;
    }
    // A layout without a TYPE field, whose lines are all points.
    void PointsOnly(const char* fields) {
        layout.SetText(pyr::kKeyChampsStation, "");
        layout.SetText(pyr::kKeyChampsVisee, "");
        layout.SetText(pyr::kKeyChampsPoint, fields);
        ASSERT_EQ(layout.Validate(), "");
    }

    pyr::CParamDriver layout{"", "", kFormat};
    pyr::ui::ScriptedFrontEnd frontEnd;
    pyr::CPyrTxtWnd txt{frontEnd};
    pyr::CCarnet records;
};
