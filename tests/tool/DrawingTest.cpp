// SPDX-License-Identifier: MIT
//
// The picture of a studio.
#include <gmock/gmock.h>

#include <random>
#include <set>

#include "Drawing.h"
#include "SomeStudio.h"
#include "ostinet/core/XML.h"

namespace Ostinet::Tool {
namespace {

bool Overlap(DrawnBox const& a, DrawnBox const& b) {
  return a.x < b.Right() && b.x < a.Right() && a.y < b.Bottom() && b.y < a.Bottom();
}

bool IsInside(DrawnBox const& box, Drawing const& drawing) {
  return box.x >= 0 && box.y >= 0 && box.Right() <= drawing.width && box.Bottom() <= drawing.height;
}

/// A studio with `devices` devices on random ports, some on none.
StudioView RandomStudio(unsigned seed, int ports, int devices) {
  std::mt19937 random(seed);
  auto const draw = [&](int count) {
    return static_cast<int>(random() % static_cast<unsigned>(count));
  };
  StudioView studio;
  unsigned long long key = 1;
  for (int i = 0; i < ports; ++i) {
    std::string const name = "Port " + std::to_string(i + 1);
    if (draw(8) != 0) {
      studio.destinations.push_back(SomeEndpoint(key++, false, name));
      studio.destinations.back().software = draw(5) == 0;
    }
    if (draw(4) != 0) {
      studio.sources.push_back(SomeEndpoint(key++, true, name));
    }
  }
  for (int i = 0; i < devices; ++i) {
    DeviceView device;
    device.key = key++;
    device.name = "Device " + std::to_string(i + 1);
    device.online = true;
    for (int e = draw(4) == 0 ? draw(4) : 1; e > 0; --e) {
      EntityView entity;
      entity.name = "Port " + std::to_string(e);
      for (int n = draw(3); n > 0; --n) {
        entity.destinations.push_back(SomeEndpoint(key++, false, device.name));
        if (!studio.destinations.empty() && draw(5) != 0) {
          auto const& port = studio.destinations[static_cast<std::size_t>(
              draw(static_cast<int>(studio.destinations.size())))];
          entity.destinations.back().port = port.name;
          entity.destinations.back().portKey = port.key;
        }
      }
      if (draw(2) == 0) {
        entity.sources.push_back(SomeEndpoint(key++, true, device.name));
      }
      device.entities.push_back(entity);
    }
    studio.devices.push_back(device);
  }
  return studio;
}

int CountConnected(StudioView const& studio) {
  int count = 0;
  for (DeviceView const& device : studio.devices) {
    for (EntityView const& entity : device.entities) {
      for (EndpointView const& end : entity.destinations) {
        count += end.portKey != 0 ? 1 : 0;
      }
    }
  }
  return count;
}

TEST(Drawing, NothingOverlapsAndAllIsInThePicture) {
  for (unsigned seed = 0; seed < 200; ++seed) {
    SCOPED_TRACE(seed);
    StudioView const studio =
        RandomStudio(seed, static_cast<int>(seed % 40), static_cast<int>(seed * 7 % 45));
    Drawing const drawing = LayOut(studio);
    ASSERT_EQ(drawing.devices.size(), studio.devices.size());
    ASSERT_EQ(drawing.cables.size(), static_cast<std::size_t>(CountConnected(studio)));
    EXPECT_TRUE(IsInside(drawing.rack, drawing));
    for (std::size_t i = 0; i < drawing.devices.size(); ++i) {
      DrawnBox const& box = drawing.devices[i].box;
      EXPECT_TRUE(IsInside(box, drawing)) << drawing.devices[i].name;
      EXPECT_FALSE(Overlap(box, drawing.rack)) << drawing.devices[i].name;
      for (std::size_t j = 0; j < i; ++j) {
        EXPECT_FALSE(Overlap(box, drawing.devices[j].box)) << i << " and " << j;
      }
      for (DrawnEnds const& ends : drawing.devices[i].ends) {
        EXPECT_GT(ends.y, box.y);
        EXPECT_LT(ends.y, box.Bottom());
      }
    }
    for (std::size_t i = 0; i < drawing.ports.size(); ++i) {
      DrawnBox const& box = drawing.ports[i].box;
      EXPECT_GE(box.y, drawing.rack.y);
      EXPECT_LE(box.Bottom(), drawing.rack.Bottom());
      EXPECT_TRUE(i == 0 || box.y >= drawing.ports[i - 1].box.Bottom());
    }
  }
}

TEST(Drawing, EachPortHasOneRowForItsInputAndItsOutput) {
  StudioView studio;
  studio.destinations = {SomeEndpoint(1, false, "A"), SomeEndpoint(2, false, "Desk Out"),
                         SomeEndpoint(3, false, "Soft")};
  studio.destinations[2].software = true;
  studio.sources = {SomeEndpoint(4, true, "Desk In"), SomeEndpoint(5, true, "A"),
                    SomeEndpoint(6, true, "Keys")};
  std::vector<std::pair<unsigned long long, unsigned long long>> rows;
  for (DrawnPort const& port : LayOut(studio).ports) {
    rows.emplace_back(port.destination, port.source);
  }
  std::vector<std::pair<unsigned long long, unsigned long long>> const expected = {
      {1, 5}, {2, 4}, {0, 6}, {3, 0}};
  EXPECT_EQ(rows, expected) << "software stands below";
}

TEST(Drawing, CablesGoTheWayThatMIDIGoes) {
  StudioView studio = SomeStudio();
  studio.devices[0].entities[0].sources[0].port = "In 1";
  studio.devices[0].entities[0].sources[0].portKey = studio.sources[0].key;
  studio.devices[0].entities[0].destinations[0].portKey = studio.destinations[0].key;
  Drawing const drawing = LayOut(studio);
  ASSERT_EQ(drawing.cables.size(), 2u);
  double const device = drawing.devices[0].JackX();
  EXPECT_EQ(drawing.cables[0].x1, device) << "from the instrument";
  EXPECT_EQ(drawing.cables[1].x2, device) << "to the instrument";
  EXPECT_NE(drawing.cables[0].x2, device);
}

TEST(Drawing, TwinsAreToldApartByWhoTheyAre) {
  StudioView studio = SomeStudio();
  studio.destinations = {SomeEndpoint(6, false, "USB"), SomeEndpoint(7, false, "USB")};
  studio.devices[0].entities[0].destinations[0].port = "USB";
  studio.devices[0].entities[0].destinations[0].portKey = 7;
  Drawing const drawing = LayOut(studio);
  ASSERT_EQ(drawing.cables.size(), 1u);
  EXPECT_FALSE(drawing.ports[0].used);
  EXPECT_TRUE(drawing.ports[1].used);
}

TEST(Drawing, DevicesOfASideKeepTheOrderOfTheirPorts) {
  StudioView const studio = RandomStudio(3, 16, 30);
  Drawing const drawing = LayOut(studio);
  for (bool const left : {false, true}) {
    double last = -1;
    int count = 0;
    for (DrawnDevice const& device : drawing.devices) {
      if (device.onLeft == left) {
        EXPECT_GT(device.box.y, last);
        last = device.box.y;
        ++count;
      }
    }
    EXPECT_GT(count, 8);
  }
}

/// What the picture shows as texts, in order; fails for what is no XML.
std::vector<std::string> TextsOf(std::string const& svg) {
  std::vector<std::string> texts;
  XMLLib::Parser parser(svg.data(), svg.size());
  XMLLib::Name const group("http://www.w3.org/2000/svg g");
  XMLLib::Name const text("http://www.w3.org/2000/svg text");
  EXPECT_TRUE(parser.DownToChild());
  while (parser.DownToChild()) {
    if (parser.CurrentElement() == text) {
      texts.push_back(parser.ReadText().string());
    } else if (parser.CurrentElement() == group) {
      while (parser.DownToChild()) {
        if (parser.CurrentElement() == text) {
          texts.push_back(parser.ReadText().string());
        }
        parser.UpToParent();
      }
    }
    parser.UpToParent();
  }
  return texts;
}

TEST(DrawingSVG, ShowsEveryNameWhateverItHolds) {
  StudioView studio = SomeStudio();
  studio.devices[0].name = "<Synth> & \"Co\" \x01 é 𝄞";
  studio.devices[0].manufacturer = "Maker's";
  std::vector<std::string> const texts = TextsOf(DrawingSVG(LayOut(studio)));
  EXPECT_THAT(texts, testing::Contains("<Synth> & \"Co\"   é 𝄞"));
  EXPECT_THAT(texts, testing::Contains("Maker's Model"));
  EXPECT_THAT(texts, testing::Contains("In/Out 1"));
}

TEST(DrawingSVG, CutsANameBetweenLettersWhereItDoesNotFit) {
  StudioView studio = SomeStudio();
  for (int i = 0; i < 40; ++i) {
    studio.devices[0].name += "日本";
  }
  std::vector<std::string> const texts = TextsOf(DrawingSVG(LayOut(studio)));
  EXPECT_THAT(
      texts, testing::Contains(testing::AnyOf(testing::EndsWith("本…"), testing::EndsWith("日…"))));
}

TEST(DrawingSVG, SquareLettersTakeTheRoomOfTwo) {
  StudioView studio = SomeStudio();
  studio.devices[0].name = "日本語の名前日本語の名前日本語の名前";  // 18
  std::vector<std::string> texts = TextsOf(DrawingSVG(LayOut(studio)));
  EXPECT_THAT(texts, testing::Contains(testing::EndsWith("…")));
  studio.devices[0].name = "eighteen letters..";
  texts = TextsOf(DrawingSVG(LayOut(studio)));
  EXPECT_THAT(texts, testing::Contains("eighteen letters.."));
  EXPECT_THAT(texts, testing::Not(testing::Contains(testing::EndsWith("…"))));
}

TEST(DrawingSVG, OfAnEmptyStudioSaysSo) {
  std::vector<std::string> const texts = TextsOf(DrawingSVG(LayOut(StudioView())));
  EXPECT_THAT(texts, testing::Contains("NO PORTS"));
  EXPECT_THAT(texts, testing::Contains("0 devices  ·  0 ports  ·  0 connections"));
}

TEST(DrawingSVG, OfTheSameStudioIsTheSame) {
  EXPECT_EQ(DrawingSVG(LayOut(RandomStudio(1, 9, 9))), DrawingSVG(LayOut(RandomStudio(1, 9, 9))));
}

}  // namespace
}  // namespace Ostinet::Tool
