// SPDX-License-Identifier: MIT
#include "database/sample/Rubrics.h"

#include <array>

namespace database::sample {

namespace {

// The one with hospital bills.
constexpr char HospitalGroup = '7';

// clang-format off
constexpr std::array<Rubric, 42> Rubrics{{
    // code    description                            percent agreg. sócio  famil. t.fam. docs s/f   min/max s   min/max f  franq.  low high vat weight
    {"1",    "Consultas",                               0,    1800,   700,   600,  1200},
    {"1.01", "Consulta de clínica geral",               0.80, 1000,   400,   350,   800,   20,   20,    5,  40,     5,  35, None,   20,   50,  0, 12},
    {"1.02", "Consulta de especialidade",               0.75, 1400,   500,   450,   900,   15,   12,   10,  60,    10,  50, None,   45,  100,  0, 14},
    {"1.03", "Consulta de pediatria",                   0.80, None,   300,   400,  None, None,   15,   10,  60,    10,  60, None,   40,   85,  0,  6, true},
    {"1.04", "Consulta de psicologia ou psiquiatria",   0.60,  900,   400,   400,   700,   12,   12, None,  45,  None,  45,   30,   40,   80,  0,  3},
    {"1.05", "Consulta ao domicílio",                   0.70, None,   300,   300,   500,    6,    6, None,  70,  None,  60, None,   60,  110,  0,  1},

    {"2",    "Meios auxiliares de diagnóstico",         0,    2200,  1000,   800,  1500},
    {"2.01", "Análises clínicas",                       0.80, 1200,   500,   400,   800, None, None,    5, 120,     5, 100, None,   15,  140,  0,  9},
    {"2.02", "Radiologia convencional",                 0.80,  900,   400,   350,   600, None, None, None,  90,  None,  80, None,   20,   90,  0,  4},
    {"2.03", "Ecografia",                               0.80,  800,   350,   300,   600,    8,    8, None, 100,  None,  90, None,   40,  110,  0,  4},
    {"2.04", "Tomografia e ressonância magnética",      0.70, 1500,   700,   600,  1000,    4,    3, None, 250,  None, 220,   50,  120,  420,  0,  2},
    {"2.05", "Endoscopia e exames especiais",           0.70, None,   500,   400,   800,    4,    4, None, 180,  None, 160, None,   80,  260,  0,  1},

    {"3",    "Medicamentos",                            0,     900,   400,   350,   700},
    {"3.01", "Medicamentos com receita",                0.70,  700,   300,   250,   500, None, None,    3,  60,     3,  50,   25,    5,   70,  6, 16},
    {"3.02", "Medicamentos de doença crónica",          0.90,  900,   400,   350,   700, None, None, None, 100,  None, 100, None,   12,  110,  6,  7},
    {"3.03", "Vacinas",                                 0.60,  300,   150,   150,   250,    4,    6, None,  60,  None,  60, None,   20,   90,  6,  2},
    {"3.04", "Material de penso e consumíveis",         0.50,  200,   100,   100,   150, None, None,    5,  30,     5,  30, None,    6,   45, 23,  2},

    {"4",    "Estomatologia",                           0,    1800,   800,   700,  1200},
    {"4.01", "Consulta e destartarização",              0.75,  600,   250,   200,   400,    6,    4, None,  50,  None,  45, None,   30,   70,  0,  7},
    {"4.02", "Obturações e extracções",                 0.70,  900,   400,   350,   600,   10,    8, None,  70,  None,  60, None,   35,  110,  0,  5},
    {"4.03", "Desvitalização",                          0.70,  800,   350,   300,   600,    4,    4, None, 130,  None, 120,   40,   90,  220,  0,  2},
    {"4.04", "Próteses dentárias",                      0.50, 1500,   700,   600,  1000,    2,    2,   50, 400,    50, 350,  100,  150,  900,  6,  2},
    {"4.05", "Ortodontia",                              0.50, None,   500,   600,  None,    6,   12, None, 100,  None, 100,   75,   60,  250,  0,  2},

    {"5",    "Oftalmologia",                            0,     900,   400,   350,   650},
    {"5.01", "Consulta de oftalmologia",                0.75,  400,   200,   150,   300,    4,    3, None,  60,  None,  50, None,   50,   95,  0,  4},
    {"5.02", "Lentes",                                  0.60,  600,   250,   220,   450,    2,    2,   20, 150,    20, 130, None,   60,  280, 23,  4},
    {"5.03", "Armações",                                0.50,  300,   120,   100,   220,    1,    1,   20,  70,    20,  60, None,   50,  190, 23,  3},
    {"5.04", "Lentes de contacto",                      0.50, None,   150,   150,   250,    4,    4, None,  50,  None,  50, None,   25,  110, 23,  2},

    {"6",    "Tratamentos e reabilitação",              0,    1600,   700,  None,  1000},
    {"6.01", "Fisioterapia",                            0.75, 1200,   500,   450,   900,   40,   40, None,  80,  None,  80,   20,   12,  120,  0,  5},
    {"6.02", "Terapia da fala",                         0.75, None,   300,   500,  None,   20,   40, None,  40,  None,  40, None,   25,   50,  0,  2},
    {"6.03", "Enfermagem e injectáveis",                0.80,  300,   120,   120,   250, None, None,    2,  25,     2,  25, None,    4,   35,  0,  3},
    {"6.04", "Tratamentos termais",                     0.40, None,   200,   150,   300,    1,    1,   50, 150,    50, 120,   50,   90,  320,  6,  1},

    {"7",    "Internamento e cirurgia",                 0,   25000, 15000, 12500, 20000},
    {"7.01", "Internamento hospitalar",                 0.90, None, 10000,  8000, 15000,    6,    6, None, 4000, None,3500, None,  300, 2800,  0,  5},
    {"7.02", "Honorários de cirurgia",                  0.80, None,  6000,  5000,  9000,    4,    4, None, 2500, None,2200,  100,  400, 2600,  0,  3},
    {"7.03", "Urgência hospitalar",                     0.80,  900,   400,   350,   700, None, None, None,  120, None, 100, None,   40,  160,  0,  4},
    {"7.04", "Parto",                                   0.90, None,  3000,  3000,  None,    1,    1, None, 2500, None,2500, None, 1200, 3200,  0,  1},

    {"8",    "Próteses e ortóteses",                    0,    2500,  1500,  1200,  None},
    {"8.01", "Próteses auditivas",                      0.60, None,  1000,   800,  None,    2,    2,  100,  700,  100, 600,  150,  250, 1400,  6,  1},
    {"8.02", "Calçado e palmilhas ortopédicas",         0.60,  400,   180,   180,   300,    2,    2,   15,  80,    15,  80, None,   35,  160,  6,  1},
    {"8.03", "Outras ortóteses",                        0.50, None,   300,   300,   500,    3,    3, None, 150,  None, 150, None,   30,  260, 23,  1},
}};
// clang-format on

constexpr std::array<Hospital, 12> Hospitals{{
    {"Hospital da Boa Nova", "Avenida do Mar, 100", "4450-208", "Matosinhos", "229 410 100"},
    {"Hospital de São Gabriel", "Rua de São Gabriel, 14", "1050-012", "Lisboa", "213 520 700"},
    {"Clínica da Lapa Nova", "Rua da Lapa, 88", "1200-701", "Lisboa", "213 970 330"},
    {"Hospital de Santa Clara", "Estrada da Beira, 220", "3000-213", "Coimbra", "239 480 400"},
    {"Casa de Saúde de Guimarães", "Rua Paulo VI, 5", "4800-412", "Guimarães", "253 420 900"},
    {"Hospital do Sado", "Avenida Luísa Todi, 310", "2900-028", "Setúbal", "265 530 600"},
    {"Hospital da Ria", "Rua da Pega, 40", "3800-164", "Aveiro", "234 400 200"},
    {"Clínica do Arade", "Avenida Miguel Bombarda, 21", "8500-510", "Portimão", "282 420 500"},
    {"Hospital do Templo", "Largo do Templo, 1", "7000-503", "Évora", "266 760 300"},
    {"Clínica Cirúrgica da Foz", "Rua do Passeio Alegre, 64", "4150-570", "Porto", "226 160 800"},
    {"Maternidade de Santo André", "Rua de Santo André, 9", "2400-137", "Leiria", "244 810 700"},
    {"Instituto de Recuperação do Tejo", "Estrada Nacional 10, km 8", "2830-145", "Barreiro",
     "212 140 100"},
}};

Value ceiling(int euros) {
    return euros == None ? Value(Null) : Value(core::Money::fromUnits(qint64{10000} * euros));
}

Value limit(int count) {
    return count == None ? Value(Null) : Value(qint64{count});
}

}  // namespace

std::span<const Rubric> rubrics() {
    return Rubrics;
}

bool isMain(const Rubric& rubric) {
    return rubric.code[1] == '\0';
}

int idOf(const Rubric& rubric) {
    return static_cast<int>(&rubric - Rubrics.data()) + 1;
}

const Rubric& mainOf(const Rubric& child) {
    const Rubric* rubric = &child;
    while (!isMain(*rubric)) --rubric;
    return *rubric;
}

bool isHospital(const Rubric& rubric) {
    return rubric.code[0] == HospitalGroup;
}

std::span<const Hospital> hospitals() {
    return Hospitals;
}

void writeRubrics(Writer& writer) {
    for (const Rubric& rubric : Rubrics) {
        const bool main = isMain(rubric);
        writer.add("tbZelmar_Plafonds",
                   {qint64{idOf(rubric)}, main ? Value(Null) : Value(qint64{idOf(mainOf(rubric))}),
                    QByteArray(rubric.code), QByteArray(rubric.descrit),
                    main ? Value(Null) : Value(rubric.percent), ceiling(rubric.agregado),
                    ceiling(rubric.socio), ceiling(rubric.familiar), ceiling(rubric.total_familia),
                    limit(rubric.nomax_recibos_socio), limit(rubric.nomax_recibos_familiar),
                    ceiling(rubric.socio_min_lan), ceiling(rubric.socio_max_lan),
                    ceiling(rubric.familiar_min_lan), ceiling(rubric.familiar_max_lan),
                    ceiling(rubric.franquia)});
    }
}

void writeHospitals(Writer& writer) {
    qint64 id = 0;
    for (const Hospital& hospital : Hospitals) {
        const QByteArray code = 'H' + QByteArray::number(++id).rightJustified(2, '0');
        writer.add("tbHospitais",
                   {id, code, QByteArray(hospital.nome), QByteArray(hospital.morada),
                    QByteArray(hospital.code_postal), QByteArray(hospital.localidade),
                    QByteArray(hospital.telefone), Null, Null});
    }
}

}  // namespace database::sample
