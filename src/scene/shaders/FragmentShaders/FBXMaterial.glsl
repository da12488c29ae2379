// A material of an FBX file, lit from above, from the eye, a little from the floor, and round its edge.
const float c_RimPower = 4.0;
const float c_RimFactor = 0.25;
// The least that is raised to a power.
const float c_SpecularFloor = 1e-10;

uniform mat4 u_View;
uniform vec3 u_Up;
uniform vec3 u_LightVector;
// Colours of the material have their factor in alpha.
uniform vec4 u_DiffuseColour;
uniform sampler2D t_DiffuseTexture;
uniform bool u_DiffuseTextureEnabled;
uniform vec4 u_SpecularColour;
uniform vec4 u_EmissiveColour;
uniform float u_Shininess;
// Colours of the subject have in alpha how much they cover.
uniform vec4 u_UserColourA;
uniform vec4 u_UserColourB;
uniform float u_Alpha;

varying vec4 v_Colour;
varying vec3 v_Normal;
varying vec3 v_Eye;
varying vec2 v_UV;

vec3 DiffuseColour()
{
	if (u_DiffuseTextureEnabled)
	{
		vec4 texel = texture2D(t_DiffuseTexture, v_UV);
		vec4 user = mix(u_UserColourA, u_UserColourB, texel.a);
		return mix(texel.rgb, user.rgb, user.a);
	}
	vec3 diffuse = u_DiffuseColour.rgb * u_DiffuseColour.a;
	return u_Alpha == 1.0 ? mix(diffuse, u_UserColourA.rgb, u_UserColourA.a) : diffuse;
}

void main()
{
	vec3 normal = normalize(v_Normal);
	vec3 eye = normalize(v_Eye);
	vec3 toCamera = ToCamera(u_View);
	// The eye's light fades where it would fall together with the top's.
	float cameraScale = max(0.0, 1.0 - dot(toCamera, u_Up));
	float light = Light(normal, toCamera, u_Up, c_Lights * vec4(1.0, 1.0, 1.0, cameraScale));
	float specular = pow(max(dot(reflect(eye, normal), u_LightVector), c_SpecularFloor), u_Shininess);
	float rim = pow(max(1.0 - dot(-eye, normal), 0.0), c_RimPower) * c_RimFactor;
	vec3 colour = v_Colour.rgb * DiffuseColour() * light + specular * u_SpecularColour.rgb * u_SpecularColour.a + rim
		+ u_EmissiveColour.rgb * u_EmissiveColour.a;
	gl_FragColor = vec4(colour, u_Alpha);
}
