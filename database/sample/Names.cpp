// SPDX-License-Identifier: MIT
#include "database/sample/Names.h"

namespace database::sample {

namespace {

constexpr std::array<const char*, 36> Women{
    "Ana",      "Maria",  "Teresa", "Isabel",   "Helena",  "Margarida", "Catarina", "Inês",
    "Joana",    "Rita",   "Sofia",  "Paula",    "Carla",   "Sandra",    "Cristina", "Filipa",
    "Susana",   "Luísa",  "Marta",  "Patrícia", "Beatriz", "Matilde",   "Leonor",   "Mariana",
    "Carolina", "Lurdes", "Fátima", "Graça",    "Glória",  "Conceição", "Rosa",     "Amélia",
    "Cláudia",  "Mónica", "Vera",   "Sílvia"};
constexpr std::array<const char*, 36> Men{
    "António", "José",    "João",   "Manuel",  "Francisco", "Luís",     "Carlos", "Paulo",
    "Pedro",   "Miguel",  "Rui",    "Nuno",    "Jorge",     "Fernando", "Vítor",  "Ricardo",
    "Tiago",   "André",   "Bruno",  "Gonçalo", "Diogo",     "Hugo",     "Sérgio", "Joaquim",
    "Álvaro",  "Mário",   "Raul",   "Duarte",  "Afonso",    "Tomás",    "Martim", "Rodrigo",
    "Simão",   "Eduardo", "Filipe", "Bernardo"};
constexpr std::array<const char*, 60> Surnames{
    "Silva",    "Santos",  "Ferreira",  "Pereira",   "Oliveira",  "Costa",     "Rodrigues",
    "Martins",  "Jesus",   "Sousa",     "Fernandes", "Gonçalves", "Gomes",     "Lopes",
    "Marques",  "Alves",   "Almeida",   "Ribeiro",   "Pinto",     "Carvalho",  "Teixeira",
    "Moreira",  "Correia", "Mendes",    "Nunes",     "Soares",    "Vieira",    "Monteiro",
    "Cardoso",  "Rocha",   "Raposo",    "Neves",     "Coelho",    "Cruz",      "Cunha",
    "Pires",    "Ramos",   "Reis",      "Simões",    "Antunes",   "Matos",     "Fonseca",
    "Machado",  "Araújo",  "Barbosa",   "Tavares",   "Lourenço",  "Castro",    "Figueiredo",
    "Azevedo",  "Freitas", "Magalhães", "Henriques", "Batista",   "Guerreiro", "Salgueiro",
    "Quintela", "Vilhena", "Assunção",  "Brandão"};
constexpr std::array<const char*, 24> Streets{"Rua das Flores",       "Rua de Santa Catarina",
                                              "Avenida da Liberdade", "Rua do Comércio",
                                              "Rua da Escola",        "Travessa do Forno",
                                              "Largo da Igreja",      "Rua Almirante Reis",
                                              "Rua 25 de Abril",      "Avenida da República",
                                              "Rua Luís de Camões",   "Praceta das Oliveiras",
                                              "Rua do Moinho Velho",  "Calçada da Ajuda",
                                              "Rua Nova do Almada",   "Rua Dr. Egas Moniz",
                                              "Avenida João XXI",     "Rua da Fonte Santa",
                                              "Rua Miguel Torga",     "Bairro da Encarnação, Lote",
                                              "Rua do Alecrim",       "Rua Padre António Vieira",
                                              "Rua de São Bento",     "Estrada da Circunvalação"};
constexpr std::array<const char*, 7> Floors{
    "", ", r/c Dto.", ", 1.º Esq.", ", 2.º Dto.", ", 3.º Frente", ", 4.º C", ""};

struct Town {
    const char* postalCode;  // the first four digits
    const char* name;
};
constexpr std::array<Town, 28> Towns{{
    {"1050", "Lisboa"},         {"1170", "Lisboa"},   {"1500", "Lisboa"},
    {"1885", "Moscavide"},      {"2005", "Santarém"}, {"2400", "Leiria"},
    {"2560", "Torres Vedras"},  {"2610", "Amadora"},  {"2655", "Ericeira"},
    {"2675", "Odivelas"},       {"2710", "Sintra"},   {"2750", "Cascais"},
    {"2780", "Oeiras"},         {"2800", "Almada"},   {"2830", "Barreiro"},
    {"2900", "Setúbal"},        {"3000", "Coimbra"},  {"3510", "Viseu"},
    {"3800", "Aveiro"},         {"4050", "Porto"},    {"4400", "Vila Nova de Gaia"},
    {"4450", "Matosinhos"},     {"4700", "Braga"},    {"4800", "Guimarães"},
    {"6000", "Castelo Branco"}, {"7000", "Évora"},    {"7800", "Beja"},
    {"8000", "Faro"},
}};

// The first is the bank that pays out.
constexpr std::array<const char*, 6> Banks{"0013", "0007", "0010", "0033", "0035", "0036"};

QByteArray digits(Random& random, int count) {
    QByteArray text;
    for (int at = 0; at < count; ++at) text += static_cast<char>('0' + random.below(10));
    return text;
}

}  // namespace

QByteArray givenName(Random& random, bool woman) {
    return woman ? random.pick(Women) : random.pick(Men);
}

QByteArray surname(Random& random) {
    return random.pick(Surnames);
}

Address address(Random& random) {
    const Town& town = random.pick(Towns);
    const QByteArray street = random.pick(Streets);
    const QByteArray separator = street.endsWith("Lote") ? " " : ", ";
    return {street + separator + QByteArray::number(random.between(1, 180)) + random.pick(Floors),
            QByteArray(town.postalCode) + '-' + digits(random, 3), town.name};
}

QByteArray staffNumber(int n) {
    const int check = ((7 - 2 * n) % 10 + 10) % 10;
    return QByteArray::number(10000 + n) + QByteArray::number(check);
}

QByteArray taxNumber(Random& random) {
    QByteArray text = (random.chance(50) ? "1" : "2") + digits(random, 7);
    int sum = 0;
    for (int at = 0; at < 8; ++at) sum += (text[at] - '0') * (9 - at);
    const int check = 11 - sum % 11;
    return text + QByteArray::number(check > 9 ? 0 : check);
}

QByteArray bankNumber(Random& random) {
    const QByteArray bank = random.chance(30) ? Banks[0] : random.pick(Banks);
    const QByteArray account = bank + digits(random, 4) + digits(random, 11);
    return account + bankCheckDigits(account);
}

QByteArray bankCheckDigits(const QByteArray& digits) {
    int rest = 0;
    for (const char digit : digits) rest = (rest * 10 + (digit - '0')) % 97;
    const int check = 98 - rest * 100 % 97;
    return QByteArray::number(check).rightJustified(2, '0');
}

}  // namespace database::sample
