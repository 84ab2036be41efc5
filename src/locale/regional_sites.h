// Regional web sites of the product. This header is shared by the string tables
// (the "Visit ..." label names the host) and by the web-site command, so each host
// is written exactly once. Plain macros only: the resource compiler includes it.
#ifndef AUTOPLAY_LOCALE_REGIONAL_SITES_H
#define AUTOPLAY_LOCALE_REGIONAL_SITES_H

#define VEMO_SITE_INTERNATIONAL "www.vemo.example"
#define VEMO_SITE_FRANCE "www.fr.vemo.example"
#define VEMO_SITE_GERMANY "www.de.vemo.example"
#define VEMO_SITE_SWEDEN "www.se.vemo.example"
#define VEMO_SITE_NETHERLANDS "www.nl.vemo.example"
#define VEMO_SITE_BRAZIL "www.br.vemo.example"
#define VEMO_SITE_SPAIN "www.es.vemo.example"
#define VEMO_SITE_ITALY "www.it.vemo.example"
#define VEMO_SITE_JAPAN "www.jp.vemo.example"
#define VEMO_SITE_TAIWAN "www.tw.vemo.example"
#define VEMO_SITE_KOREA "kr.vemo.example"
#define VEMO_SITE_UNITED_KINGDOM "www.uk.vemo.example"
#define VEMO_SITE_NORWAY "www.no.vemo.example"
#define VEMO_SITE_DENMARK "www.dk.vemo.example"

// Korea's site is reached through one full address; every other site is opened by its bare
// host name, which the shell takes for a web address only when it starts with "www.".
#define VEMO_SITE_KOREA_ADDRESS "http://" VEMO_SITE_KOREA "/index.html"

#endif
