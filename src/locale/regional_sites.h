// Regional web sites of the product. This header is shared by the string tables
// (the "Visit ..." label names the host) and by the web-site command, so each host
// is written exactly once. Plain macros only: the resource compiler includes it.
#ifndef AUTOPLAY_LOCALE_REGIONAL_SITES_H
#define AUTOPLAY_LOCALE_REGIONAL_SITES_H

#define VEMO_SITE_INTERNATIONAL "www.vemo.example"
#define VEMO_SITE_FRANCE "fr.vemo.example"
#define VEMO_SITE_GERMANY "de.vemo.example"
#define VEMO_SITE_SWEDEN "se.vemo.example"
#define VEMO_SITE_NETHERLANDS "nl.vemo.example"
#define VEMO_SITE_BRAZIL "br.vemo.example"
#define VEMO_SITE_SPAIN "es.vemo.example"
#define VEMO_SITE_ITALY "it.vemo.example"
#define VEMO_SITE_JAPAN "jp.vemo.example"
#define VEMO_SITE_TAIWAN "tw.vemo.example"
#define VEMO_SITE_KOREA "kr.vemo.example"
#define VEMO_SITE_UNITED_KINGDOM "uk.vemo.example"
#define VEMO_SITE_NORWAY "no.vemo.example"
#define VEMO_SITE_DENMARK "dk.vemo.example"

// Korea's site is reached through one full address; every other site is opened
// by its bare host name.
#define VEMO_SITE_KOREA_ADDRESS "http://" VEMO_SITE_KOREA "/index.html"

#endif
