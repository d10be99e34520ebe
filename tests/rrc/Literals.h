// Messages made for the tests, without data of a real network. MessageTSharkTest checks that another reader agrees on
// each.
#pragma once

#include <array>
#include <string_view>

#include "rrc/Pdu.h"

namespace vespscope::test {

struct Literal {
  std::string_view name;
  rrc::Pdu pdu;
  std::string_view hex;
};

inline constexpr Literal literals[] = {
    {"mib", rrc::Pdu::lteBcchBch, "769400"},
    {"sib1", rrc::Pdu::lteBcchDlSch, "7cc0040340802469579bc02ed2d2d2c65afe121021887069ec706cfe360131400470"},
    {"si", rrc::Pdu::lteBcchDlSch,
     "00864a4bb88d7aea168000bfe5a0f020039de0a2856456caf304ca0fbd061416400c07bdae0003fffc500f882700050462401db00940c0105"
     "b8258448788"},
    {"si67", rrc::Pdu::lteBcchDlSch,
     "009183a5711881533008142200125e0c4500a53090141409ffe320785497f848c01b41f014860500ff0021"},
    {"sib2", rrc::Pdu::lteBcchDlSch, "000371e1b9218c37ec902c1b024b4048060100605354b552cbc8d2d92038e200205b9200595fc0"},
    {"recon-drx", rrc::Pdu::lteDlDcch,
     "220680183b00b0416efb27b72c9ebcb096028a0554e78937fffc1aa720e00e01f401050047813f2540"},
    {"recon-drx-v1130", rrc::Pdu::lteDlDcch, "22020456efb27b72e2880011f8a0"},
    {"recon-drx-release", rrc::Pdu::lteDlDcch, "2202041380"},
    {"recon-default-mac", rrc::Pdu::lteDlDcch, "22020480"},
    {"recon-handover", rrc::Pdu::lteDlDcch,
     "22187f200830053fffeab400165418128a57002401e0088c38107104e48010233000206004c456f1e1083d5001094288c80018280760001f0"
     "800108c5843d0024700ed8001900021b38f0b225172aa4beef0000b00900c"},
    {"report-lte", rrc::Pdu::lteUlDcch,
     "08322f5411e532fdd0010080810187fff7c31042015fc009720291ca1300e0c202814f000061c084c603203272400fbde341a000680400"},
    {"report-umts", rrc::Pdu::lteUlDcch, "0810000093fec062ff5800"},
    {"report-gsm", rrc::Pdu::lteUlDcch, "08100001052badf8"},
    {"report-nr", rrc::Pdu::lteUlDcch, "0810000200140fab7f0000"},
    {"release", rrc::Pdu::lteDlDcch, "2c02"},
    {"release-geran", rrc::Pdu::lteDlDcch, "2c3c20a100f13ffffc04b28003000295c6c15048416dd00048139201881118070800"},
    {"release-eutra", rrc::Pdu::lteDlDcch, "2c281ffff01c00fa00"},
    {"release-nr", rrc::Pdu::lteDlDcch, "2c23020825d78100"},
    {"request", rrc::Pdu::lteUlCcch, "55555555555c"},
    {"request-tmsi", rrc::Pdu::lteUlCcch, "400000000004"},
    {"reestablishment-request", rrc::Pdu::lteUlCcch, "08c034d00004"},
    {"reject", rrc::Pdu::lteDlCcch, "41e0"},
    {"setup", rrc::Pdu::lteDlCcch, "60020b77d93db970"},
    {"setup-complete", rrc::Pdu::lteUlDcch, "20220000ff03076016"},
    {"security", rrc::Pdu::lteDlDcch, "360020"},
    {"mobility", rrc::Pdu::lteDlDcch, "181460800224466aa0"},
    {"mobility-geran", rrc::Pdu::lteDlDcch, "180e055780"},
    {"paging", rrc::Pdu::ltePcch, "68800000000000ffffffffffb0"},
    {"dl-transfer", rrc::Pdu::lteDlDcch, "0800183b00b0"},
    {"ul-transfer", rrc::Pdu::lteUlDcch, "480060ec02c0"},
    {"nr-mib", rrc::Pdu::nrBcchBch, "556e24"},
    {"nr-report", rrc::Pdu::nrUlDcch, "00420a17ef5ed46c880473c647c5008afa2ffc03f4005000"},
    {"nr-report-lte", rrc::Pdu::nrUlDcch, "00420a17ef5ed46c880473c647c500c00281f7f862fe00"},
    {"nr-reconfiguration", rrc::Pdu::nrReconfiguration,
     "882907580a601282927240089a2613880000006202cb037b010580003a5fbac30823f72300000c83780200"},
    {"nr-reconfiguration-dcch", rrc::Pdu::nrDlDcch, "000c0018080000"},
    {"recon-nr", rrc::Pdu::lteDlDcch,
     "2200a4a0821830ae20a41d6029804a0a49c9002268984e20000001880b2c0dec04160000e97eeb0c208fdc8c0000320de00800"},
    {"recon-nr-release", rrc::Pdu::lteDlDcch, "2200a4a0821800"},
    {"nr-transfer", rrc::Pdu::lteUlDcch, "9c41800420a17ef5ed46c880473c647c5008afa2ffc03f40050000"},
    {"nb-mib", rrc::Pdu::nbBcchBch, "a4d3a00000"},
    {"nb-sib1", rrc::Pdu::nbBcchDlSch, "400010800806009a00000c700013050840"},
    {"nb-request", rrc::Pdu::nbUlCcch, "2aaaaaaaaaaa800000"},
    {"nb-release", rrc::Pdu::nbDlDcch, "2463c1e0c4e280"},
    {"nb-paging", rrc::Pdu::nbPcch, "20"},
};

}  // namespace vespscope::test
