// SPDX-License-Identifier: MIT
#pragma once

#include <span>

#include "database/sample/Writer.h"

namespace database::sample {

/// No ceiling.
inline constexpr int None = -1;

/// A rubric of the sample, amounts in whole euros. Ids count from 1 in the order of the list.
struct Rubric {
    const char* code;
    const char* descrit;
    double percent;  // 0..1, a fraction; of a main rubric nothing
    int agregado = None;
    int socio = None;
    int familiar = None;
    int total_familia = None;
    int nomax_recibos_socio = None;
    int nomax_recibos_familiar = None;
    int socio_min_lan = None;
    int socio_max_lan = None;
    int familiar_min_lan = None;
    int familiar_max_lan = None;
    int franquia = None;
    // What its documents look like; not kept in the book.
    int low = 0;  // value
    int high = 0;
    int vat = 0;     // per cent
    int weight = 0;  // how often it occurs
    bool forChildren = false;
};

/// All rubrics; a main rubric stands before its children.
std::span<const Rubric> rubrics();
bool isMain(const Rubric& rubric);
int idOf(const Rubric& rubric);
/// The main rubric of a child.
const Rubric& mainOf(const Rubric& child);
/// A child whose documents are hospital bills.
bool isHospital(const Rubric& rubric);

struct Hospital {
    const char* nome;
    const char* morada;
    const char* code_postal;
    const char* localidade;
    const char* telefone;
};
std::span<const Hospital> hospitals();

void writeRubrics(Writer& writer);
void writeHospitals(Writer& writer);

}  // namespace database::sample
